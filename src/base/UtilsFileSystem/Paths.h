#pragma once

#include <boost/filesystem/path.hpp>

#include <cstddef>
#include <string>

namespace UtilsFileSystem
{

/// Paths as UTF-8, whatever the system's own form is.
boost::filesystem::path PathFromUtf8(const std::string& i_rText);
std::string ToUtf8(const boost::filesystem::path& i_rPath);

/// The form in which Windows takes an absolute path of i_Limit or more characters: slashes turned, and prefixed with
/// "\\?\", or "\\?\UNC" for a network path. Shorter paths and those that have a prefix come back as they are.
std::wstring AddLongPathPrefix(std::wstring i_Path, std::size_t i_Limit);

/// One path for a file or directory however it is spelled; what is not there stays as it is.
boost::filesystem::path Canonical(const boost::filesystem::path& i_rPath);

} // namespace UtilsFileSystem
