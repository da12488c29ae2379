#include "Flow2TypesUtils/ParameterTyped.h"

#include "Flow2TypesUtils/ParameterText.h"

#include <algorithm>

namespace Flow2Utils
{

template <typename T>
VParameterTyped<T>::VParameterTyped(std::string i_Name, T* i_pVariable)
    : VParameter(std::move(i_Name)), m_pVariable(i_pVariable ? i_pVariable : &m_Own)
{
}

template <typename T>
VParameterTyped<T>::VParameterTyped(const VParameterTyped& i_rOther)
    : VParameter(i_rOther), m_Own(*i_rOther.m_pVariable), m_pVariable(&m_Own), m_Default(i_rOther.m_Default),
      m_Minimum(i_rOther.m_Minimum), m_Maximum(i_rOther.m_Maximum), m_Permitted(i_rOther.m_Permitted)
{
}

template <typename T>
void VParameterTyped<T>::Set(T i_Value)
{
	if (IsSet() && *m_pVariable == i_Value)
		return;
	*m_pVariable = std::move(i_Value);
	NoteChange(true);
}

template <typename T>
void VParameterTyped<T>::SetDefault(T i_Default)
{
	if (m_bHasDefault && m_Default == i_Default)
		return;
	m_Default = std::move(i_Default);
	m_bHasDefault = true;
	if (!IsSet())
		Reset();
}

template <typename T>
std::unique_ptr<VParameter> VParameterTyped<T>::Clone() const
{
	return std::unique_ptr<VParameter>(new VParameterTyped(*this));
}

template <typename T>
std::string VParameterTyped<T>::GetText() const
{
	return IsSet() || HasDefault() ? ToText(Get()) : std::string();
}

template <typename T>
bool VParameterTyped<T>::SetText(const std::string& i_rText)
{
	const auto found = std::ranges::find(m_Permitted, i_rText, &std::pair<std::string, T>::first);
	T value{};
	if (found != m_Permitted.end())
		value = found->second;
	else if (!FromText(i_rText, value))
		return false;
	Set(std::move(value));
	return true;
}

template <typename T>
bool VParameterTyped<T>::SetFrom(const VParameter& i_rOther)
{
	if (!i_rOther.IsSet() && !i_rOther.HasDefault())
		return false;
	const auto* const pSame = dynamic_cast<const VParameterTyped*>(&i_rOther);
	if (!pSame)
		return SetText(i_rOther.GetText());
	Set(pSame->Get());
	return true;
}

template <typename T>
void VParameterTyped<T>::Reset()
{
	if (!IsSet() && (!HasDefault() || *m_pVariable == m_Default))
		return;
	if (HasDefault())
		*m_pVariable = m_Default;
	NoteChange(false);
}

template <typename T>
bool VParameterTyped<T>::IsValid(std::string& o_rMessage) const
{
	o_rMessage.clear();
	if (!IsSet() && !HasDefault())
	{
		if (!m_bOptional)
			o_rMessage = "Value is not set";
		return m_bOptional;
	}
	const T& rValue = Get();
	const auto isValue = [&rValue](const auto& i_rPermitted) { return i_rPermitted.second == rValue; };
	if (m_Minimum && *m_Minimum > rValue)
		o_rMessage = "Value is less than permitted minimum";
	else if (m_Maximum && !(*m_Maximum >= rValue)) // What is not a number is not within a maximum.
		o_rMessage = "Value is greater than permitted maximum";
	else if (!m_Permitted.empty() && std::ranges::none_of(m_Permitted, isValue))
		o_rMessage = "Value is not one of the permitted values";
	return o_rMessage.empty();
}

template <typename T>
std::vector<std::string> VParameterTyped<T>::PermittedTexts() const
{
	std::vector<std::string> texts;
	std::ranges::transform(m_Permitted, std::back_inserter(texts), &std::pair<std::string, T>::first);
	return texts;
}

template <typename T>
std::map<std::string, std::string> VParameterTyped<T>::GetAttributes() const
{
	std::map<std::string, std::string> attributes = VParameter::GetAttributes();
	if (m_Minimum)
		attributes.emplace("<RangeMin>", ToText(*m_Minimum));
	if (m_Maximum)
		attributes.emplace("<RangeMax>", ToText(*m_Maximum));
	if (HasDefault())
		attributes.emplace("<DefaultValue>", ToText(m_Default));
	return attributes;
}

template class VParameterTyped<bool>;
template class VParameterTyped<std::int32_t>;
template class VParameterTyped<std::uint32_t>;
template class VParameterTyped<float>;
template class VParameterTyped<double>;
template class VParameterTyped<std::string>;

} // namespace Flow2Utils
