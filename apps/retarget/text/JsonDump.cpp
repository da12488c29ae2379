#include "retarget/text/JsonDump.h"

#include "CoreOrlexTypes/Fields.h"

namespace CommandLine
{
namespace
{

using namespace CoreOrlexTypes;

template <typename T>
VJson ToJson(const T& i_rValue);

template <typename TList>
VJson ListToJson(const TList& i_rList)
{
	VJson list = VJson::array();
	for (const auto& rItem : i_rList)
		list.push_back(ToJson(rItem));
	return list;
}

template <typename T>
inline constexpr bool c_bList = false;
template <typename T>
inline constexpr bool c_bList<std::vector<T>> = true;
template <typename T, std::size_t N>
inline constexpr bool c_bList<std::array<T, N>> = true;

template <typename T>
VJson ToJson(const T& i_rValue)
{
	if constexpr (std::is_same_v<T, VColour>)
	{
		return VJson::array({i_rValue.m_Red, i_rValue.m_Green, i_rValue.m_Blue, i_rValue.m_Alpha});
	}
	else if constexpr (CRecord<T>)
	{
		VJson record = VJson::object();
		ForEachField<T>(
		    [&](const auto& i_rField) { record[std::string(i_rField.Key)] = ToJson(i_rValue.*i_rField.pMember); });
		return record;
	}
	else if constexpr (CEnumeration<T>)
	{
		// A value that no enumerator names can still be told by its number.
		const std::string_view name = EnumeratorName(i_rValue);
		return name.empty() ? VJson(static_cast<std::int32_t>(i_rValue)) : VJson(name);
	}
	else if constexpr (c_bList<T>)
	{
		return ListToJson(i_rValue);
	}
	else
	{
		return i_rValue;
	}
}

} // namespace

VJson Dump(const VSubjectRecord& i_rRecord)
{
	return ToJson(i_rRecord);
}

VJson Dump(const VSubject& i_rSubject)
{
	VJson json = VJson::object();
	json["Subject"] = ToJson(i_rSubject);
	return json;
}

} // namespace CommandLine
