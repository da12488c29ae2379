#pragma once

#include <boost/filesystem/path.hpp>

#include <optional>
#include <string>

namespace RetargetSetup
{

/// The file name up to its last dot; the whole name if it has none.
std::string FileStem(const boost::filesystem::path& i_rPath);

/// The file name from its last dot on; empty if it has none.
std::string FileExtension(const boost::filesystem::path& i_rPath);

/// SHA-256 of what a file holds; none if it cannot be read.
std::optional<std::string> DigestOf(const boost::filesystem::path& i_rPath);

} // namespace RetargetSetup
