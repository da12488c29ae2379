#pragma once

#include "fbxsdk/container/ElementTree.h"
#include "fbxsdk/container/RecordWriter.h"

#include <functional>

namespace FbxFormat
{

/// Records that are to stand behind the last ones of a list at the top of a file.
struct VInsertion
{
	std::string_view m_List;
	std::function<void(VRecordWriter&)> m_Write;
};

/// Puts records into a binary file. All its other bytes stay, but for the places at which records end, and for the
/// zeros before the end of the file that bring that to its place. Nothing is put where the file has no such list, or an
/// empty one.
/// @param i_rTree read of the file without a finding
/// @return false if the file would become larger than its version, or our reader, takes.
bool InsertRecords(std::string_view i_File, std::uint32_t i_Version, const VElementTree& i_rTree,
    const std::vector<VInsertion>& i_rInsertions, std::string& o_rBytes);

} // namespace FbxFormat
