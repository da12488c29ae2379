#pragma once

#include "fbxsdk/container/Progress.h"

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>

namespace FbxFormat
{

/// The bytes of a file. They are copied and not mapped: a file that is overwritten while it is read must not be able
/// to end the process.
class VFileBytes
{
public:
	/// False with a reason if the file cannot be opened or is larger than c_FileBytes.
	/// i_Limit bytes at most are read.
	bool Read(const std::string& i_rPath, std::size_t i_Limit, std::string& o_rReason);

	/// The same, all of it, telling how far it has got; a cancelled reading fails.
	bool Read(const std::string& i_rPath, VProgress& io_rProgress, std::string& o_rReason);

	/// Room for that many bytes, which are undefined.
	char* Resize(std::size_t i_Size);

	std::string_view View() const { return {m_pBytes.get(), m_Size}; }

private:
	bool Read(const std::string& i_rPath, std::size_t i_Limit, VProgress& io_rProgress, std::string& o_rReason);

	std::unique_ptr<char[]> m_pBytes;
	std::size_t m_Size = 0;
};

} // namespace FbxFormat
