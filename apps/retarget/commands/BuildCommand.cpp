#include "CommandLineText/Messages.h"
#include "CommandLineText/Parsing.h"
#include "retarget/commands/Commands.h"
#include "retarget/subject/Making.h"
#include "retarget/subject/Recipe.h"
#include "retarget/subject/SetupFile.h"
#include "retarget/text/InputFile.h"
#include "retarget/text/Output.h"
#include "retarget/text/OutputFile.h"

#include "DebugServices/GlobalLog.h"
#include "FileDigest/FileDigest.h"

#include <algorithm>
#include <utility>

namespace CommandLine
{
namespace
{

struct VBuildSettings
{
	std::string m_Recipe;
	VOutput m_Out;
	bool m_bDryRun = false;
};

/// A field of the text, as "FILE:LINE: "; its first line for one that it does not have.
std::string WhereOf(const SetupIO::VSetup& i_rSetup, const std::string& i_rPath, const std::string& i_rField)
{
	const auto& rFields = i_rSetup.m_Fields.m_Value;
	const auto field = std::ranges::find(rFields, i_rField, &std::pair<std::string, std::size_t>::first);
	return i_rPath + ":" + std::to_string(field == rFields.end() ? 1 : field->second) + ": ";
}

VMaking MakingOf(const SetupIO::VSetup& i_rRecipe, const std::string& i_rPath)
{
	if (i_rRecipe.m_Fbx.empty() == i_rRecipe.m_Subject.empty())
		throw VCommandError(EBadInput,
		    WhereOf(i_rRecipe, i_rPath, i_rRecipe.m_Subject.empty() ? "" : "subject")
		        + "a recipe begins with one file: either \"fbx\" or \"subject\"");
	if (!i_rRecipe.m_Root.empty() && i_rRecipe.m_Fbx.empty())
		throw VCommandError(EBadInput,
		    WhereOf(i_rRecipe, i_rPath, "root") + "\"root\" chooses a bone of an FBX file, and \"subject\" has none");
	const auto beside = [&](const std::string& i_rFile)
	{ return i_rFile.empty() ? i_rFile : PathBeside(i_rPath, i_rFile); };
	VMaking making{
	    beside(i_rRecipe.m_Fbx), beside(i_rRecipe.m_Subject), beside(i_rRecipe.m_Source), {}, i_rRecipe.m_RootHeight};
	if (!i_rRecipe.m_Root.empty())
	{
		making.m_Root = i_rRecipe.m_Root;
		making.m_RootWhere = WhereOf(i_rRecipe, i_rPath, "root");
	}
	return making;
}

/// What goes in. The digest of a file is made before it is read, and again when all have been: of one that changed in
/// between nobody knows which bytes were read.
class VInputs
{
public:
	/// @param i_rName as the recipe has it
	/// @param i_rWhere it stands there, as "FILE:LINE: "
	void AddFile(const std::string& i_rName, const std::string& i_rFile, const std::string& i_rWhere)
	{
		if (!i_rName.empty() && i_rFile != c_pStandardStream)
			m_Inputs.push_back({i_rName, i_rFile, DigestOf(i_rFile, i_rWhere)});
	}
	/// The bytes themselves.
	void AddText(const std::string& i_rName, const std::string& i_rText)
	{
		if (i_rName != c_pStandardStream)
			m_Inputs.push_back({i_rName, "", FileDigest::Sha256OfBytes(i_rText)});
	}

	VJson Told() const
	{
		VJson told = VJson::array();
		for (const VInput& rInput : m_Inputs)
		{
			if (!rInput.m_File.empty() && DigestOf(rInput.m_File, "") != rInput.m_Digest)
				throw VCommandError(EBadInput,
				    "\"" + rInput.m_Name + "\" changed while it was read, and nothing is written: build again");
			NVX_LOG(c_pCategory, NVX::ELogInformation, "Input \"%1%\": SHA-256 %2%", rInput.m_Name, rInput.m_Digest);
			told.push_back({{"file", rInput.m_Name}, {"sha256", rInput.m_Digest}});
		}
		return told;
	}

private:
	struct VInput
	{
		std::string m_Name;
		/// Empty for a text.
		std::string m_File;
		std::string m_Digest;
	};

	static std::string DigestOf(const std::string& i_rFile, const std::string& i_rWhere)
	{
		std::string error;
		const auto digest = FileDigest::Sha256(InputPath(i_rFile), error);
		if (!digest)
			throw VCommandError(EBadInput, i_rWhere + error);
		return *digest;
	}

	std::vector<VInput> m_Inputs;
};

EExitStatus Build(const VBuildSettings& i_rSettings)
{
	const std::string& rPath = i_rSettings.m_Recipe;
	const std::string text = ReadSetupText(rPath, "a recipe");
	VInputs inputs;
	inputs.AddText(rPath, text);
	const SetupIO::VSetup recipe = ParseSetup(text, rPath,
	    {"fbx", "subject", "source", "output", "root", "root-height", "pairs", "edits", "checks"}, "a recipe");
	const VMaking making = MakingOf(recipe, rPath);
	VOutput out = i_rSettings.m_Out;
	if (out.m_Path.empty() && !recipe.m_Output.empty())
		out.m_Path = PathBeside(rPath, recipe.m_Output);
	if (out.m_Path.empty() && !i_rSettings.m_bDryRun)
		throw VCommandError(EWrongUsage, rPath + " has no \"output\": give one, or -o OUT.qrr");
	const VEdits edits = EditsOf(recipe, rPath, !making.m_Fbx.empty());
	if (!out.m_Path.empty())
		CheckOutput(out, c_RetargetSubjectFile, {rPath, making.m_Fbx, making.m_Source});
	if (recipe.m_Checks && recipe.m_Checks->m_bNoWarnings)
		AskStrict();
	VSession session;
	for (const auto& [pField, rName] : {std::pair<const char*, const std::string&>("fbx", recipe.m_Fbx),
	         {"subject", recipe.m_Subject}, {"source", recipe.m_Source}})
		inputs.AddFile(rName, PathBeside(rPath, rName), WhereOf(recipe, rPath, pField));
	for (const VEdit& rEdit : edits)
		if (rEdit.m_pKind && rEdit.m_pKind->m_bFile)
			inputs.AddFile(rEdit.m_Value, rEdit.m_Value, rEdit.m_Where);
	try
	{
		MakeSubject(session, making, edits);
	}
	catch (const VCommandError& rError)
	{
		const std::string reason = rError.what();
		throw VCommandError(rError.Status(), reason.starts_with(rPath) ? reason : rPath + ": " + reason);
	}
	session.m_ReportJson["inputs"] = inputs.Told();
	std::vector<std::string> broken;
	if (recipe.m_Checks)
		broken = BrokenChecks(session, *recipe.m_Checks);
	for (const std::string& rSentence : broken)
		NVX_LOG(c_pCategory, NVX::ELogError, "%1%: a check does not hold: %2%", rPath, rSentence);
	if (!broken.empty())
		throw VCommandError(EFindings,
		    rPath + ": " + std::to_string(broken.size()) + " of the checks do not hold, and nothing is written");
	if (i_rSettings.m_bDryRun)
	{
		session.m_ReportJson["dryRun"] = true;
		RequireNoErrors();
	}
	else
		session.Save(out.m_Path);
	session.Report(out.m_Path);
	return EFine;
}

} // namespace

VCommand AddBuildCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "build",
	    "Make a retarget subject as a recipe tells: from which files, with which pairs and edits, and what must hold "
	    "of "
	    "it, or nothing is written (exit status 1). The same recipe and files give the same bytes, those that the same "
	    "options of \"create\" or \"edit\" give",
	    {"build hero.json", "build hero.json --dry-run -v", "build hero.json -o /tmp/hero.qrr --json"});
	const auto pSettings = std::make_shared<VBuildSettings>();
	pApp->add_option("RECIPE.json", pSettings->m_Recipe,
	        "The recipe, in the form that \"retarget schema setup\" tells; its paths are relative to its folder; - is "
	        "standard input")
	    ->required();
	pApp->add_option("-o,--output", pSettings->m_Out.m_Path,
	        "Where the retarget subject is saved, in place of what the recipe says; - is standard output")
	    ->option_text("OUT.qrr");
	AddForceOption(*pApp, pSettings->m_Out);
	pApp->add_flag("--dry-run", pSettings->m_bDryRun, "Do everything but write");
	return {pApp, [pSettings] { return Build(*pSettings); }};
}

} // namespace CommandLine
