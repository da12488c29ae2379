#pragma once

#include <cstdint>
#include <map>
#include <memory>
#include <string>
#include <typeinfo>
#include <vector>

namespace TesselPluginInterface
{
enum class EFileAccess : std::int32_t;
}

namespace Flow2Utils
{

/// A plain typed variable of the preview with what a control and a file need to know about it. Its value counts once it
/// was set; until then its default does, if it has one.
class VParameter
{
public:
	explicit VParameter(std::string i_Name);
	virtual ~VParameter();
	VParameter& operator=(const VParameter&) = delete;

	const std::string& Name() const { return m_Name; }
	bool IsSet() const { return m_bSet; }
	bool HasDefault() const { return m_bHasDefault; }

	/// How often the value has become another one, was set or was reset.
	std::uint64_t ChangeCounter() const { return m_ChangeCounter; }

	/// A copy whose value is a variable of its own.
	virtual std::unique_ptr<VParameter> Clone() const = 0;

	virtual const std::type_info& Type() const = 0;

	/// The value, or else the default; empty without both.
	virtual std::string GetText() const = 0;

	/// A text of the permitted list stands for its value; any other is read as a value, permitted or not.
	/// @return false, with nothing changed, for a text that is no value of the type.
	virtual bool SetText(const std::string& i_rText) = 0;

	/// Takes the value or default of another parameter, by way of its text if that is of another type.
	/// @return false, with nothing changed, if that has neither or its text cannot be read.
	virtual bool SetFrom(const VParameter& i_rOther) = 0;

	/// Back to not set, and to the default if there is one.
	virtual void Reset() = 0;

	/// Tells if value or default keep to the limits and the permitted list, and if there has to be one.
	/// @param o_rMessage what is wrong, or empty.
	virtual bool IsValid(std::string& o_rMessage) const = 0;

	/// The texts of the permitted list, in order.
	virtual std::vector<std::string> PermittedTexts() const = 0;

	/// What there is to say about the parameter, as texts by key: "<FriendlyName>", "<RangeMin>", "<RangeMax>",
	/// "<DefaultValue>", "<Description>", "<Category>", "<Advanced>", "<Hidden>", "<Serialized>" (only "false"),
	/// "<FileAccess>" and "<FileFilter>".
	virtual std::map<std::string, std::string> GetAttributes() const;

	std::string m_FriendlyName;
	std::string m_Description;
	std::string m_Category;
	/// Valid without a value and a default.
	bool m_bOptional = false;
	bool m_bAdvanced = false;
	bool m_bHidden = false;
	bool m_bSerialised = true;
	/// None.
	TesselPluginInterface::EFileAccess m_FileAccess{};
	std::string m_FileFilter;

protected:
	/// For Clone.
	VParameter(const VParameter&);

	void NoteChange(bool i_bSet);

	bool m_bHasDefault = false;

private:
	const std::string m_Name;
	bool m_bSet = false;
	std::uint64_t m_ChangeCounter = 0;
};

} // namespace Flow2Utils
