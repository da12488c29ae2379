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

VMaking MakingOf(const SetupIO::VSetup& i_rRecipe, const std::string& i_rPath)
{
	if (i_rRecipe.m_Fbx.empty() == i_rRecipe.m_Subject.empty())
		throw VCommandError(EBadInput, i_rPath + ": a recipe begins with one file: either \"fbx\" or \"subject\"");
	if (!i_rRecipe.m_Root.empty() && i_rRecipe.m_Fbx.empty())
		throw VCommandError(EBadInput, i_rPath + ": \"root\" chooses a bone of an FBX file, and \"subject\" has none");
	const auto beside = [&](const std::string& i_rFile)
	{ return i_rFile.empty() ? i_rFile : PathBeside(i_rPath, i_rFile); };
	VMaking making{
	    beside(i_rRecipe.m_Fbx), beside(i_rRecipe.m_Subject), beside(i_rRecipe.m_Source), {}, i_rRecipe.m_RootHeight};
	if (!i_rRecipe.m_Root.empty())
		making.m_Root = i_rRecipe.m_Root;
	return making;
}

/// What went in: the files by their paths in the recipe.
VJson Digests(const SetupIO::VSetup& i_rRecipe, const VEdits& i_rEdits, const std::string& i_rPath)
{
	VJson digests = VJson::array();
	const auto add = [&](const std::string& i_rName, const std::string& i_rFile)
	{
		if (i_rName.empty() || i_rFile == c_pStandardStream)
			return;
		std::string error;
		const auto digest = FileDigest::Sha256(InputPath(i_rFile), error);
		if (!digest)
			throw VCommandError(EBadInput, error);
		NVX_LOG(c_pCategory, NVX::ELogInformation, "Input \"%1%\": SHA-256 %2%", i_rName, *digest);
		digests.push_back({{"file", i_rName}, {"sha256", *digest}});
	};
	add(i_rPath, i_rPath);
	for (const std::string& rName : {i_rRecipe.m_Fbx, i_rRecipe.m_Subject, i_rRecipe.m_Source})
		add(rName, PathBeside(i_rPath, rName));
	for (const VEdit& rEdit : i_rEdits)
		if (rEdit.m_pKind && rEdit.m_pKind->m_bFile)
			add(rEdit.m_Value, rEdit.m_Value);
	return digests;
}

EExitStatus Build(const VBuildSettings& i_rSettings)
{
	const std::string& rPath = i_rSettings.m_Recipe;
	const SetupIO::VSetup recipe = ParseSetup(ReadSetupText(rPath, "a recipe"), rPath,
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
	session.m_ReportJson["inputs"] = Digests(recipe, edits, rPath);
	MakeSubject(session, making, edits);
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
