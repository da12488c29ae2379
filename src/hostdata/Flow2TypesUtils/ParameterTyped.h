#pragma once

#include "Flow2TypesUtils/Parameter.h"

#include <optional>
#include <utility>

namespace Flow2Utils
{

/// A parameter of type bool, std::int32_t, std::uint32_t, float, double or std::string.
template <typename T>
class VParameterTyped : public VParameter
{
public:
	/// @param i_pVariable where the value lives, which must outlive the parameter; null gives it a variable of its own.
	explicit VParameterTyped(std::string i_Name, T* i_pVariable = nullptr);

	/// The value, or else the default; what the variable holds without both.
	const T& Get() const { return IsSet() || !HasDefault() ? *m_pVariable : m_Default; }
	void Set(T i_Value);

	/// A variable whose value was not set takes the default.
	void SetDefault(T i_Default);
	void SetMinimum(T i_Minimum) { m_Minimum = std::move(i_Minimum); }
	void SetMaximum(T i_Maximum) { m_Maximum = std::move(i_Maximum); }
	void AddPermitted(std::string i_Text, T i_Value)
	{
		m_Permitted.emplace_back(std::move(i_Text), std::move(i_Value));
	}

	std::unique_ptr<VParameter> Clone() const override;
	const std::type_info& Type() const override { return typeid(T); }
	std::string GetText() const override;
	bool SetText(const std::string& i_rText) override;
	bool SetFrom(const VParameter& i_rOther) override;
	void Reset() override;
	bool IsValid(std::string& o_rMessage) const override;
	std::vector<std::string> PermittedTexts() const override;
	std::map<std::string, std::string> GetAttributes() const override;

private:
	VParameterTyped(const VParameterTyped& i_rOther);

	T m_Own{};
	T* const m_pVariable;
	T m_Default{};
	std::optional<T> m_Minimum;
	std::optional<T> m_Maximum;
	std::vector<std::pair<std::string, T>> m_Permitted;
};

extern template class VParameterTyped<bool>;
extern template class VParameterTyped<std::int32_t>;
extern template class VParameterTyped<std::uint32_t>;
extern template class VParameterTyped<float>;
extern template class VParameterTyped<double>;
extern template class VParameterTyped<std::string>;

} // namespace Flow2Utils
