#include "retarget/text/MotionFile.h"

#include "CommandLineText/ExitStatus.h"
#include "CommandLineText/Messages.h"
#include "retarget/text/InputFile.h"

#include "MotionIO/PrintMotion.h"
#include "NVX/Status.h"
#include "UtilsFileSystem/Files.h"
#include "UtilsFileSystem/Paths.h"
#include "UtilsFileSystem/SaveFile.h"

namespace CommandLine
{
namespace
{

bool BeginsMotion(std::string_view i_Head)
{
	return i_Head.starts_with("HIERARCHY") || i_Head.starts_with("glTF") || i_Head.starts_with("Kaydara FBX Binary");
}

const VOutputKind c_MotionFile{"a motion", {".bvh", ".glb", ".fbx"}, BeginsMotion};

} // namespace

void CheckMotionOutput(const VMotionOutput& i_rOutput, const std::vector<std::string>& i_rInputs)
{
	if (i_rOutput.m_Path == c_pStandardStream)
		throw VCommandError(EWrongUsage, "A motion is written by the extension of its file: give it a name");
	CheckOutput(i_rOutput, c_MotionFile, i_rInputs);
	if (i_rOutput.m_Character.empty()
	    && MotionIO::MotionFormOf(LowerExtension(i_rOutput.m_Path)) != MotionIO::EMotionForm::Bvh)
		throw VCommandError(
		    EWrongUsage, "\"" + i_rOutput.m_Path + "\": that form holds the character, too: --fbx names its FBX file");
}

void WriteMotionFile(const TakeIO::VTake& i_rMotion, const VMotionOutput& i_rOutput)
{
	using namespace MotionIO;
	VCharacterFile character{i_rOutput.m_Character, {}};
	std::string bytes, error;
	if (!character.m_Path.empty()
	    && UtilsFileSystem::ReadWholeFile(InputPath(character.m_Path), c_LargestInput, character.m_Bytes, error)
	        != NVX::Status::c_Success)
		throw VCommandError(EBadInput, "\"" + character.m_Path + "\" could not be read. " + error);
	VMotionSettings settings;
	settings.m_Name = i_rOutput.m_Name;
	settings.m_Scale = i_rOutput.m_Scale;
	const EPrinted printed = PrintMotion(i_rMotion, *MotionFormOf(LowerExtension(i_rOutput.m_Path)),
	    character.m_Path.empty() ? nullptr : &character, settings, bytes, error);
	if (printed == EPrinted::CharacterUnreadable)
		throw VCommandError(EBadInput, "\"" + character.m_Path + "\" could not be read as a character. " + error);
	if (printed != EPrinted::Done)
		throw VCommandError(EBadOutput, "\"" + i_rOutput.m_Path + "\" was not written. " + error);
	// A picture that is missing is missed, and no reason to have nothing.
	ForgiveErrors();
	RequireNoErrors();
	if (UtilsFileSystem::SaveFile(UtilsFileSystem::PathFromUtf8(i_rOutput.m_Path), bytes, error)
	    != NVX::Status::c_Success)
		throw VCommandError(EBadOutput, error);
}

} // namespace CommandLine
