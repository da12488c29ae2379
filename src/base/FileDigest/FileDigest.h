#pragma once

#include <boost/filesystem/path.hpp>

#include <optional>
#include <string>
#include <string_view>

namespace FileDigest
{

/// SHA-256 (FIPS 180-4) of a file's bytes, as 64 lower-case hexadecimal digits.
/// @param o_rError if it cannot be read: why, with the path.
std::optional<std::string> Sha256(const boost::filesystem::path& i_rPath, std::string& o_rError);

/// The same of bytes in memory.
std::string Sha256OfBytes(std::string_view i_Bytes);

} // namespace FileDigest
