#include "retarget/text/OutputFile.h"

#include "CommandLineText/ExitStatus.h"
#include "CommandLineText/Messages.h"
#include "retarget/text/Output.h"

#include "NVX/Status.h"
#include "RetargetSetupCore/FilePath.h"
#include "UtilsFileSystem/Paths.h"
#include "UtilsFileSystem/Platform.h"
#include "UtilsFileSystem/SaveFile.h"

#include <boost/algorithm/string/case_conv.hpp>
#include <boost/filesystem/operations.hpp>

#include <algorithm>
#include <cstdio>
#include <memory>

namespace CommandLine
{
namespace
{

/// So far a file is read to see what it is: comments may stand before the root of an XML file.
constexpr std::size_t c_HeadSize = 64 * 1024;

/// The name of the first element, without a prefix; empty if there is none.
std::string_view RootElement(std::string_view i_Head)
{
	const auto skipTo = [&](std::string_view i_End)
	{
		const std::size_t at = i_Head.find(i_End);
		i_Head.remove_prefix(at == std::string_view::npos ? i_Head.size() : at + i_End.size());
	};
	if (i_Head.starts_with("\xEF\xBB\xBF"))
		i_Head.remove_prefix(3);
	for (;;)
	{
		i_Head.remove_prefix(std::min(i_Head.find_first_not_of(" \t\r\n"), i_Head.size()));
		if (i_Head.starts_with("<!--"))
			skipTo("-->");
		else if (i_Head.starts_with("<?"))
			skipTo("?>");
		else if (i_Head.starts_with("<!"))
			skipTo(">");
		else
			break;
	}
	if (!i_Head.starts_with('<'))
		return {};
	const std::string_view name = i_Head.substr(1, i_Head.find_first_of(" \t\r\n/>") - 1);
	return name.substr(name.find(':') + 1);
}

bool BeginsSkeletonFile(std::string_view i_Head)
{
	return RootElement(i_Head) == "KinematicModel";
}

bool BeginsSchema(std::string_view i_Head)
{
	return RootElement(i_Head) == "schema";
}

bool BeginsDrawing(std::string_view i_Head)
{
	return RootElement(i_Head) == "svg";
}

bool BeginsJson(std::string_view i_Head)
{
	i_Head.remove_prefix(std::min(i_Head.find_first_not_of(" \t\r\n"), i_Head.size()));
	return i_Head.starts_with('{');
}

bool BeginsPicture(std::string_view i_Head)
{
	return i_Head.starts_with("\x89PNG\r\n\x1A\n");
}

bool BeginsPage(std::string_view i_Head)
{
	return i_Head.starts_with("<!DOCTYPE html>");
}

/// False if the file cannot be read.
bool ReadHead(const boost::filesystem::path& i_rPath, std::string& o_rHead)
{
	int error = 0;
	const std::unique_ptr<std::FILE, int (*)(std::FILE*)> pFile(
	    UtilsFileSystem::Platform::Open(i_rPath, "rb", error), std::fclose);
	if (!pFile)
		return false;
	o_rHead.resize(c_HeadSize);
	o_rHead.resize(std::fread(o_rHead.data(), 1, o_rHead.size(), pFile.get()));
	return std::ferror(pFile.get()) == 0;
}

/// "a", "a or b", "a, b or c".
std::string Alternatives(const std::vector<std::string>& i_rTexts)
{
	std::string text;
	for (std::size_t i = 0; i < i_rTexts.size(); ++i)
		text += (i == 0 ? "" : i + 1 == i_rTexts.size() ? " or " : ", ") + i_rTexts[i];
	return text;
}

} // namespace

const VOutputKind c_RetargetSubjectFile{"a retarget subject", {".qrr"}, BeginsSkeletonFile};
const VOutputKind c_SkeletonFamilyFile{"a skeleton file", {".qrt", ".qrk", ".qrs", ".qrr"}, BeginsSkeletonFile};
const VOutputKind c_PerformerFile{"a performer's skeleton", {".qrs"}, BeginsSkeletonFile};
const VOutputKind c_DrawingFile{"an SVG drawing", {".svg"}, BeginsDrawing};
const VOutputKind c_SchemaFile{"an XML schema", {".xsd"}, BeginsSchema};
const VOutputKind c_SetupFile{"a set-up in JSON", {".json"}, BeginsJson};
const VOutputKind c_PictureFile{"a PNG picture", {".png"}, BeginsPicture};
const VOutputKind c_PageFile{"an HTML page", {".html", ".htm"}, BeginsPage};

void AddForceOption(CLI::App& io_rApp, VOutput& io_rOutput)
{
	io_rApp.add_flag("--force", io_rOutput.m_bForce, "Replace a file of another kind that stands where is written");
}

void CheckOutput(const VOutput& i_rOutput, const VOutputKind& i_rKind, const std::vector<std::string>& i_rInputs)
{
	const std::string& rPath = i_rOutput.m_Path;
	if (rPath == "-" && JsonAsked())
		throw VCommandError(
		    EWrongUsage, "--json reports on standard output, where -o - puts the file: give the file a name");
	if (rPath == "-")
		return;
	boost::system::error_code error;
	for (const std::string& rInput : i_rInputs)
		if (boost::filesystem::equivalent(rPath, rInput, error) && !error)
			throw VCommandError(EWrongUsage, "\"" + rPath + "\" is an input that saving there would destroy");
	const std::string extension = LowerExtension(rPath);
	if (std::find(i_rKind.m_Extensions.begin(), i_rKind.m_Extensions.end(), extension) == i_rKind.m_Extensions.end())
		throw VCommandError(EWrongUsage,
		    "\"" + rPath + "\": what is written is " + i_rKind.m_pName + "; let the name of its file end in "
		        + Alternatives(i_rKind.m_Extensions));
	if (i_rOutput.m_bForce || !boost::filesystem::is_regular_file(rPath, error))
		return;
	std::string head;
	if (!ReadHead(UtilsFileSystem::PathFromUtf8(rPath), head))
		throw VCommandError(EBadOutput,
		    "\"" + rPath + "\" is there but cannot be read, so that it may be anything; --force replaces it");
	if (!head.empty() && !i_rKind.m_pBegins(head))
		throw VCommandError(EBadOutput,
		    "\"" + rPath + "\" is there, and is not " + i_rKind.m_pName
		        + ": give another name, or --force to replace it");
}

void WriteText(const std::string& i_rText, const std::string& i_rPath)
{
	RequireNoErrors();
	if (i_rPath == "-")
		return Print(i_rText);
	std::string reason;
	if (UtilsFileSystem::SaveFile(UtilsFileSystem::PathFromUtf8(i_rPath), i_rText, reason) != NVX::Status::c_Success)
		throw VCommandError(EBadOutput, reason);
}

std::string LowerExtension(const std::string& i_rPath)
{
	return boost::algorithm::to_lower_copy(RetargetSetup::FileExtension(UtilsFileSystem::PathFromUtf8(i_rPath)));
}

} // namespace CommandLine
