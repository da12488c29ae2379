#pragma once

#include "fbxsdk/container/ElementTree.h"

#include <cstdint>
#include <initializer_list>
#include <span>
#include <variant>

namespace FbxFormat
{

/// A value of a record: a number, text as it stands in a file of the same form, the text form's escapes included, or an
/// array of numbers, which the binary form deflates and the text form lists.
using VWrittenValue = std::variant<std::int64_t, std::int32_t, double, std::string_view, std::span<const std::int64_t>,
    std::span<const std::int32_t>, std::span<const float>>;

/// Writes records. What is beyond c_Records is left out: whoever reads the file says so.
class VRecordWriter
{
public:
	/// A whole file, in the form of the tree from which values are taken over as they stand.
	explicit VRecordWriter(const VElementTree& i_rSource);

	/// Records to stand at that place of a binary file of that version.
	VRecordWriter(std::uint32_t i_Version, std::size_t i_Place);

	/// Adds a record; those that follow up to Close are its children.
	void Open(std::string_view i_Name, std::initializer_list<VWrittenValue> i_Values = {});
	void Close();

	void Add(std::string_view i_Name, std::initializer_list<VWrittenValue> i_Values);
	/// Adds a record with the values of one in the source, which must be there; nothing for c_NoElement.
	void Copy(std::string_view i_Name, VElementIndex i_Element);

	/// The whole file, or the records alone that are to stand in one.
	std::string Finish();

private:
	bool Begin(std::string_view i_Name, std::string_view i_Values, std::uint32_t i_Count);
	void End(std::size_t i_Record);

	const VElementTree* const m_pSource;
	const bool m_bText;
	/// From version 7.5 on the counts of a record have 64 bits.
	const bool m_bWide;
	/// Of the first byte in the file.
	const std::size_t m_Place;
	std::string m_Bytes;
	/// Where the open records begin.
	std::vector<std::size_t> m_Open;
	std::size_t m_Records = 0;
};

} // namespace FbxFormat
