#pragma once

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>

namespace FbxFile
{

/// The bytes of a file. They are copied and not mapped: a file that is overwritten while it is read must not be able
/// to end the process.
class VFileBytes
{
public:
	/// False with a reason if the file cannot be opened or is larger than c_FileBytes.
	/// i_Limit bytes at most are read.
	bool Read(const std::string& i_rPath, std::size_t i_Limit, std::string& o_rReason);

	std::string_view View() const { return {m_pBytes.get(), m_Size}; }

private:
	std::unique_ptr<char[]> m_pBytes;
	std::size_t m_Size = 0;
};

} // namespace FbxFile
