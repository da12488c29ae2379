#pragma once

#include "Flow2TypesUtils/ParameterTyped.h"
#include "NVX/Signal.h"
#include "NVX/Status.h"

#include <functional>
#include <map>
#include <memory>
#include <string>

namespace Flow2TypesUtils
{
struct FlowParametersItem;
}

namespace Flow2Utils
{

/// Keeps a change notification alive for as long as it lives; it may outlive the set.
class VParameterSetCookie
{
public:
	explicit VParameterSetCookie(NVX::VConnection i_Connection) : m_Connection(std::move(i_Connection)) {}
	~VParameterSetCookie() { m_Connection.Disconnect(); }
	VParameterSetCookie(const VParameterSetCookie&) = delete;
	VParameterSetCookie& operator=(const VParameterSetCookie&) = delete;

private:
	NVX::VConnection m_Connection;
};

/// What the latest item of parameters was applied to, and how, so that the same work is not done again each frame.
struct VUpdateParametersCookie
{
	std::shared_ptr<const Flow2TypesUtils::FlowParametersItem> m_pItem;
	std::uint64_t m_ChangeCounter = 0;
	std::uint32_t m_Flags = 0;
};

/// Parameters by name. One thread at a time.
class VParameterSet
{
public:
	enum EFlags : std::uint32_t
	{
		/// What goes wrong is appended to the caller's message.
		EReport = 1
	};

	VParameterSet();
	~VParameterSet();
	VParameterSet(const VParameterSet&) = delete;
	VParameterSet& operator=(const VParameterSet&) = delete;

	/// @return false, with the set as it was, for null and for a name that is taken.
	bool Add(std::unique_ptr<VParameter> i_pParameter);

	/// Null for a name that is not in the set. Values are set by the set, which tells of it.
	const VParameter* Find(const std::string& i_rName) const;

	const std::map<std::string, std::unique_ptr<VParameter>>& Parameters() const { return m_Parameters; }

	/// @return 0; 0x80000011 for a name that is not in the set; 0x80000016 for a text that does not parse. Then nothing
	/// has changed. Limits are IsValid's matter.
	/// @param io_pMessage with EReport, takes one line for what went wrong.
	std::uint32_t SetParameter(const std::string& i_rName, const std::string& i_rText, std::uint32_t i_Flags = 0,
	    std::string* io_pMessage = nullptr);

	/// @return as SetParameter, and 0x80000000 for a parameter of another type.
	template <typename T>
	std::uint32_t SetValue(const std::string& i_rName, const T& i_rValue);

	/// The value, or else the default, of the parameter; i_Fallback if it has none, is of another type or not there.
	template <typename T>
	T Value(const std::string& i_rName, T i_Fallback) const;

	/// All parameters back to not set, and to their defaults.
	void Reset();

	/// True if all parameters are valid.
	/// @param o_rMessage one line for each that is not, or empty.
	bool IsValid(std::string& o_rMessage) const;

	/// Takes the values and defaults that an item of parameters holds. Those that cannot be taken do not stop the
	/// others. The same item, or one of the same identity and revision, is not applied again with the same flags while
	/// nothing else has changed the set since it was applied without an error.
	/// @return 0, or the first error as SetParameter tells it. No item is no error.
	std::uint32_t Apply(const std::shared_ptr<const Flow2TypesUtils::FlowParametersItem>& i_rpItem,
	    std::uint32_t i_Flags = 0, std::string* io_pMessage = nullptr);

	/// Rises with every change of a value and with every parameter that is added.
	std::uint64_t ChangeCounter() const { return m_ChangeCounter; }

	/// The callback is called with a parameter's name after its value has changed.
	[[nodiscard]] std::shared_ptr<VParameterSetCookie> Watch(std::function<void(const std::string&)> i_Callback);

	/// A copy of the parameters, with variables of their own, that nobody watches: what an item carries.
	std::shared_ptr<VParameterSet> Clone() const;

private:
	VParameter* FindMutable(const std::string& i_rName);
	/// @param i_rSet changes the parameter; false if it could not.
	std::uint32_t Change(const std::string& i_rName, const std::function<bool(VParameter&)>& i_rSet,
	    std::uint32_t i_Flags, std::string* io_pMessage);
	/// Tells of a change that came after the given state of the parameter's counter.
	void TellChange(const VParameter& i_rParameter, std::uint64_t i_CounterBefore);

	std::map<std::string, std::unique_ptr<VParameter>> m_Parameters;
	std::uint64_t m_ChangeCounter = 0;
	VUpdateParametersCookie m_UpdateCookie;
	NVX::VSignal<std::string> m_ChangedSignal;
};

template <typename T>
std::uint32_t VParameterSet::SetValue(const std::string& i_rName, const T& i_rValue)
{
	VParameter* const pParameter = FindMutable(i_rName);
	if (!pParameter)
		return NVX::Status::c_UnknownName;
	auto* const pTyped = dynamic_cast<VParameterTyped<T>*>(pParameter);
	if (!pTyped)
		return NVX::Status::c_Failure;
	const std::uint64_t before = pParameter->ChangeCounter();
	pTyped->Set(i_rValue);
	TellChange(*pParameter, before);
	return NVX::Status::c_Success;
}

template <typename T>
T VParameterSet::Value(const std::string& i_rName, T i_Fallback) const
{
	const auto* const pTyped = dynamic_cast<const VParameterTyped<T>*>(Find(i_rName));
	return pTyped && (pTyped->IsSet() || pTyped->HasDefault()) ? pTyped->Get() : std::move(i_Fallback);
}

} // namespace Flow2Utils
