#include "retarget/subject/SetupFile.h"

#include "CommandLineText/ExitStatus.h"
#include "retarget/text/InputFile.h"

#include "NVX/Status.h"
#include "SetupIO/Limits.h"
#include "SetupIO/ReadSetup.h"
#include "UtilsFileSystem/Files.h"
#include "UtilsFileSystem/Paths.h"

namespace CommandLine
{
namespace
{

[[noreturn]] void Fail(const std::string& i_rPath, const SetupIO::VFault& i_rFault)
{
	throw VCommandError(EBadInput,
	    i_rPath + (i_rFault.m_Line > 0 ? ":" + std::to_string(i_rFault.m_Line) : std::string()) + ": "
	        + i_rFault.m_Reason);
}

} // namespace

std::string ReadSetupText(const std::string& i_rPath, const char* i_pUse)
{
	using SetupIO::Limits::c_FileBytes;
	std::string text;
	std::string reason;
	if (UtilsFileSystem::ReadWholeFile(InputPath(i_rPath, c_FileBytes), c_FileBytes, text, reason)
	    != NVX::Status::c_Success)
		throw VCommandError(EBadInput, "\"" + i_rPath + "\" could not be read as " + i_pUse + ": " + reason);
	return text;
}

SetupIO::VSetup ParseSetup(const std::string& i_rText, const std::string& i_rPath,
    std::initializer_list<std::string_view> i_Fields, const char* i_pUse)
{
	SetupIO::VSetup setup;
	SetupIO::VFault fault;
	if (!SetupIO::ReadSetup(i_rText, setup, fault) || !SetupIO::HasOnly(setup, i_Fields, i_pUse, fault))
		Fail(i_rPath, fault);
	return setup;
}

std::string PathBeside(const std::string& i_rTextPath, const std::string& i_rPath)
{
	const boost::filesystem::path path = UtilsFileSystem::PathFromUtf8(i_rPath);
	return i_rTextPath == c_pStandardStream || path.is_absolute()
	    ? i_rPath
	    : UtilsFileSystem::ToUtf8((UtilsFileSystem::PathFromUtf8(i_rTextPath).parent_path() / path).lexically_normal());
}

} // namespace CommandLine
