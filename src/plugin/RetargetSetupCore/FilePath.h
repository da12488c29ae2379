#pragma once

#include <boost/filesystem/path.hpp>

#include <string>

namespace RetargetSetup
{

/// The file name up to its last dot; the whole name if it has none.
std::string FileStem(const boost::filesystem::path& i_rPath);

/// The file name from its last dot on; empty if it has none.
std::string FileExtension(const boost::filesystem::path& i_rPath);

} // namespace RetargetSetup
