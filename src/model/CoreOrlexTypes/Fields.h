#pragma once

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectApplicationData.h"
#include "CoreOrlexTypes/SubjectParametrised.h"
#include "CoreOrlexTypes/SubjectRecord.h"
#include "CoreOrlexTypes/TextForm.h"

#include <array>
#include <cstddef>
#include <optional>
#include <string_view>
#include <type_traits>

/// The one description of the subject types: keys, members and what they mean, in declared order. Equality, the text
/// form and every other form of these types are made from it. Costly to compile: for source files only.
///
/// A value is one of: bool, std::uint8_t (of a colour), std::uint32_t, double, std::string, an enumeration
/// (CEnumeration), std::array, std::vector, or a record (CRecord) of such values. A visitor overloads on these kinds
/// and calls ForEachField for the records.
namespace CoreOrlexTypes
{

template <typename TOwner, typename TMember>
struct VField
{
	constexpr VField(std::string_view i_Key, TMember TOwner::*i_pMember, std::string_view i_Doc = {})
	    : Key(i_Key), pMember(i_pMember), Doc(i_Doc)
	{
	}

	std::string_view Key;
	TMember TOwner::*pMember;
	std::string_view Doc;
};

template <typename E>
struct VEnumerator
{
	E Value;
	std::string_view Name;
	std::string_view Doc = {};
};

template <typename E, std::size_t c_Count>
struct VEnumeration
{
	constexpr VEnumeration(
	    std::string_view i_Name, std::string_view i_Doc, const VEnumerator<E> (&i_rEnumerators)[c_Count])
	    : Name(i_Name), Doc(i_Doc), Enumerators(std::to_array(i_rEnumerators))
	{
	}

	/// Qualified by the types that it stands in, as "SubjectParametrised.Joint.EJointType".
	std::string_view Name;
	std::string_view Doc;
	std::array<VEnumerator<E>, c_Count> Enumerators;
};

/// A list of fields in their order: calls what it is given with all of them. Lighter on compilers than a tuple.
template <typename... TField>
constexpr auto Fields(TField... i_Field)
{
	return [i_Field...](auto&& i_rCall) { return i_rCall(i_Field...); };
}

/// The Fields of each record type.
template <typename T>
inline constexpr auto c_Fields = nullptr;

/// A VEnumeration for each enumeration.
template <typename E>
inline constexpr auto c_Enumeration = nullptr;

template <typename T>
concept CRecord = !std::is_same_v<decltype(c_Fields<T>), const std::nullptr_t>;

template <typename E>
concept CEnumeration = std::is_enum_v<E> && !std::is_same_v<decltype(c_Enumeration<E>), const std::nullptr_t>;

/// Calls the visitor with each VField of the record type, in declared order.
template <CRecord T, typename TVisitor>
constexpr void ForEachField(TVisitor&& i_rVisitor)
{
	c_Fields<T>([&](const auto&... i_rField) { (i_rVisitor(i_rField), ...); });
}

template <CRecord T>
inline constexpr std::size_t c_FieldCount = c_Fields<T>([](const auto&... i_rField) { return sizeof...(i_rField); });

/// Empty for a value outside the enumeration.
template <CEnumeration E>
constexpr std::string_view EnumeratorName(E i_Value)
{
	for (const VEnumerator<E>& rEnumerator : c_Enumeration<E>.Enumerators)
		if (rEnumerator.Value == i_Value)
			return rEnumerator.Name;
	return {};
}

template <CEnumeration E>
constexpr std::optional<E> EnumeratorFromName(std::string_view i_Name)
{
	for (const VEnumerator<E>& rEnumerator : c_Enumeration<E>.Enumerators)
		if (rEnumerator.Name == i_Name)
			return rEnumerator.Value;
	return std::nullopt;
}

template <>
inline constexpr auto c_Fields<VColour> = Fields(VField("Red", &VColour::m_Red), VField("Green", &VColour::m_Green),
    VField("Blue", &VColour::m_Blue), VField("Alpha", &VColour::m_Alpha));

} // namespace CoreOrlexTypes

#include "CoreOrlexTypes/FieldsOfSubject.h"
#include "CoreOrlexTypes/FieldsOfSubjectApplicationData.h"
#include "CoreOrlexTypes/FieldsOfSubjectParametrised.h"

namespace CoreOrlexTypes
{

template <>
inline constexpr auto c_Fields<VSubjectRecord> = Fields(
    VField("SubjectParametrised", &VSubjectRecord::m_SubjectParametrised, "The editable subject."),
    VField("SubjectApplicationData", &VSubjectRecord::m_SubjectApplicationData, "What draws the subject."));

template <>
inline constexpr auto c_Fields<VTextHeader> = Fields(
    VField("Version", &VTextHeader::m_Version, "Major, minor and patch version of what follows."),
    VField("Schema", &VTextHeader::m_Schema, "Name of the schema of what follows."));

} // namespace CoreOrlexTypes
