#include "RetargetSetupCore/FilePath.h"

#include "FileDigest/FileDigest.h"
#include "UtilsFileSystem/Paths.h"

namespace RetargetSetup
{

std::string FileStem(const boost::filesystem::path& i_rPath)
{
	const std::string name = UtilsFileSystem::ToUtf8(i_rPath.filename());
	return name.substr(0, name.rfind('.'));
}

std::string FileExtension(const boost::filesystem::path& i_rPath)
{
	const std::string name = UtilsFileSystem::ToUtf8(i_rPath.filename());
	const std::size_t dot = name.rfind('.');
	return dot == std::string::npos ? std::string() : name.substr(dot);
}

std::optional<std::string> DigestOf(const boost::filesystem::path& i_rPath)
{
	std::string reason;
	return FileDigest::Sha256(i_rPath, reason);
}

} // namespace RetargetSetup
