#pragma once

#include <boost/filesystem/path.hpp>

#include <cstdint>
#include <string>
#include <string_view>

namespace UtilsFileSystem
{

/// The one way in which files are saved: afterwards the path holds either all of the new bytes or what it held before,
/// also when the disk is full or the process is killed in between. The bytes go to a new file in the same folder, must
/// be on the disk in full, and the new file then takes the name of the old one. Symbolic links are followed, and the
/// old file's rights are kept. Anything but a regular file, and a read-only file, is refused.
/// @return NVX::Status::c_Success, c_FileNotOpened if the place cannot be written to, c_WriteFailure if not all bytes
/// could be written; in these cases o_rError tells why, with the path.
std::uint32_t SaveFile(const boost::filesystem::path& i_rPath, std::string_view i_Bytes, std::string& o_rError);

/// Removes what saves of this process that are on their way have written so far, in this copy of the library. For the
/// handler of a signal that ends the process, which must then end: what the saves stood for stays as it was. A process
/// that ends otherwise leaves that file, and the next save of the same path on this machine removes it.
void RemoveUnfinishedSaves() noexcept;

} // namespace UtilsFileSystem
