#pragma once

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectRecord.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

/// The readable form of the subject types, and of legacy retarget subject files.
///
/// A record is "[" all values in declared order, separated by ",", "]", or "{" pairs of a quoted key, ":" and a value,
/// separated by ",", "}". In the second spelling unknown keys are ignored, of equal keys the first counts and a missing
/// key leaves its field as it was. Lists are "[" values "]", colours the list of their four numbers, texts are quoted
/// with the escapes `\n` and `\r` and a backslash before any other byte that is meant literally; `\t` stands for two
/// bytes, the tab and the letter t. Enumerations are quoted enumerator names, booleans 0, 1, false or true. The bytes
/// 9, 10, 13 and 32 may stand before every token, and a zero byte ends the text.
namespace CoreOrlexTypes
{

/// Stands before the record in a legacy file.
struct VTextHeader
{
	std::array<std::uint32_t, 3> m_Version{};
	std::string m_Schema;
};

/// Reads one value from the start of a text into io_rValue and ignores what stands behind it.
/// @param o_pRead if not null, receives the number of bytes that were read.
/// @return false if the text is not in this form or over the limits of Limits.h; io_rValue is then partly filled.
[[nodiscard]] bool ReadText(std::string_view i_Text, VTextHeader& io_rValue, std::size_t* o_pRead = nullptr);
[[nodiscard]] bool ReadText(std::string_view i_Text, VSubjectRecord& io_rValue, std::size_t* o_pRead = nullptr);
[[nodiscard]] bool ReadText(std::string_view i_Text, VSubjectParametrised& io_rValue, std::size_t* o_pRead = nullptr);
[[nodiscard]] bool ReadText(
    std::string_view i_Text, VSubjectApplicationData& io_rValue, std::size_t* o_pRead = nullptr);
[[nodiscard]] bool ReadText(std::string_view i_Text, VSubject& io_rValue, std::size_t* o_pRead = nullptr);

enum class ETextSpelling
{
	EKeyed,
	EPositional
};

/// Appends a value to a text, so that reading it back gives an equal one.
/// @return false if the form cannot hold the value: an enumeration outside its enumerators, a text with a zero byte.
[[nodiscard]] bool WriteText(
    const VTextHeader& i_rValue, std::string& io_rText, ETextSpelling i_Spelling = ETextSpelling::EKeyed);
[[nodiscard]] bool WriteText(
    const VSubjectRecord& i_rValue, std::string& io_rText, ETextSpelling i_Spelling = ETextSpelling::EKeyed);
[[nodiscard]] bool WriteText(
    const VSubjectParametrised& i_rValue, std::string& io_rText, ETextSpelling i_Spelling = ETextSpelling::EKeyed);
[[nodiscard]] bool WriteText(
    const VSubjectApplicationData& i_rValue, std::string& io_rText, ETextSpelling i_Spelling = ETextSpelling::EKeyed);
[[nodiscard]] bool WriteText(
    const VSubject& i_rValue, std::string& io_rText, ETextSpelling i_Spelling = ETextSpelling::EKeyed);

} // namespace CoreOrlexTypes
