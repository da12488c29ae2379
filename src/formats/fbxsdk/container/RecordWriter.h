#pragma once

#include "fbxsdk/container/ElementTree.h"

#include <initializer_list>
#include <variant>

namespace FbxFormat
{

/// A value of a record: a number, or text as it stands in a file of the same form, the text form's escapes included.
using VWrittenValue = std::variant<std::int64_t, double, std::string_view>;

/// Writes a file of records, in the form of the tree from which values are taken over as they stand. What is beyond
/// c_Records is left out: whoever reads the file says so.
class VRecordWriter
{
public:
	explicit VRecordWriter(const VElementTree& i_rSource);

	/// Adds a record; those that follow up to Close are its children.
	void Open(std::string_view i_Name, std::initializer_list<VWrittenValue> i_Values = {});
	void Close();

	void Add(std::string_view i_Name, std::initializer_list<VWrittenValue> i_Values);
	/// Adds a record with the values of one in the source; nothing for c_NoElement.
	void Copy(std::string_view i_Name, VElementIndex i_Element);

	/// The whole file.
	std::string Finish();

private:
	bool Begin(std::string_view i_Name, std::string_view i_Values, std::uint32_t i_Count);
	void End(std::size_t i_Record);

	const VElementTree& m_rSource;
	const bool m_bText;
	std::string m_Bytes;
	/// Where the open records begin.
	std::vector<std::size_t> m_Open;
	std::size_t m_Records = 0;
};

} // namespace FbxFormat
