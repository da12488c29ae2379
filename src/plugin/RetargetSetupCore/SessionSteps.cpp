#include "RetargetSetupCore/SessionSteps.h"

#include "CoreOrlexTypes/JointType.h"
#include "RetargetSetupCore/FilePath.h"
#include "RetargetSetupCore/RetargetTargets.h"
#include "RetargetSetupCore/StepNames.h"
#include "UtilsFileSystem/Paths.h"
#include "math/NumberText.h"

#include <boost/filesystem/operations.hpp>

#include <algorithm>
#include <utility>

using CoreOrlexTypes::VSubjectParametrised;
using VTarget = VSubjectParametrised::VTarget;

namespace RetargetSetup
{
namespace
{

using VEdits = std::vector<SetupIO::VEdit>;

SetupIO::VEdit Command(const char* i_pName, std::optional<std::string> i_Value = {})
{
	return {i_pName, std::move(i_Value), {}, {}};
}

std::string Assigned(std::size_t i_Target, const std::string& i_rValue)
{
	return std::to_string(i_Target) + "=" + i_rValue;
}

/// What a field of the target's offset would take to hold this expression.
std::string TypedText(const VSubjectParametrised& i_rSubject, const VTarget& i_rTarget, const std::string& i_rText)
{
	double length = 0.0;
	if (i_rTarget.m_Type == VTarget::ELocalRotationToWorldRotation || i_rSubject.m_DynamicParameters.empty()
	    || NumberText::ScanReal(i_rText, length) == 0)
		return i_rText;
	return NumberText::PrintShortest(length * i_rSubject.m_DynamicParameters.back().m_Value);
}

/// For all three, empty where it is the same as before.
std::string TypedTexts(
    const VSubjectParametrised& i_rSubject, const VTarget& i_rTarget, const std::vector<std::string>& i_rBefore)
{
	std::string texts;
	for (std::size_t i = 0; i < i_rTarget.m_StateExpressions.size(); ++i)
	{
		const std::string& rText = i_rTarget.m_StateExpressions[i];
		const bool bSame = i < i_rBefore.size() && rText == i_rBefore[i];
		texts += (i > 0 ? "," : "") + (bSame ? std::string() : TypedText(i_rSubject, i_rTarget, rText));
	}
	return texts;
}

bool AddTargetEdits(const VSubjectParametrised& i_rSubject, std::size_t i_Target, const VSubjectParametrised* i_pSource,
    VEdits& io_rEdits)
{
	const VTarget& rTarget = i_rSubject.m_Targets[i_Target];
	const std::string* const pName = SourceName(i_rSubject, rTarget);
	if (!i_pSource || !pName || rTarget.m_SegmentIndices.empty())
		return false;
	const auto source = std::ranges::find(i_pSource->m_Segments, *pName, &VSubjectParametrised::VSegment::m_Name);
	if (source == i_pSource->m_Segments.end())
		return false;
	const std::size_t target = rTarget.m_SegmentIndices.front();
	const bool bPosition = rTarget.m_Type == VTarget::ELocalPointToWorldPoint;
	io_rEdits.push_back(Command(bPosition ? "position" : "rotation",
	    WordOf(std::size_t(source - i_pSource->m_Segments.begin()), *i_pSource) + ":" + WordOf(target, i_rSubject)));
	if (rTarget.m_Weight != VTarget().m_Weight)
		io_rEdits.push_back(Command("weight", Assigned(i_Target, NumberText::PrintShortest(rTarget.m_Weight))));
	// Of several segments of the name it may have been another one that the offset was measured to.
	if (std::ranges::count(i_pSource->m_Segments, *pName, &VSubjectParametrised::VSegment::m_Name) > 1)
		io_rEdits.push_back(Command("expressions", Assigned(i_Target, TypedTexts(i_rSubject, rTarget, {}))));
	return true;
}

void AddTargetChanges(const VSubjectParametrised& i_rBefore, const VSubjectParametrised& i_rAfter, std::size_t i_Target,
    VEdits& io_rEdits)
{
	const VTarget& rBefore = i_rBefore.m_Targets[i_Target];
	const VTarget& rAfter = i_rAfter.m_Targets[i_Target];
	if (rBefore.m_Weight != rAfter.m_Weight)
		io_rEdits.push_back(Command("weight", Assigned(i_Target, NumberText::PrintShortest(rAfter.m_Weight))));
	if (rBefore.m_StateExpressions != rAfter.m_StateExpressions)
		io_rEdits.push_back(
		    Command("expressions", Assigned(i_Target, TypedTexts(i_rAfter, rAfter, rBefore.m_StateExpressions))));
}

bool AddPoses(const VSubjectParametrised& i_rBefore, const VSubjectParametrised& i_rAfter, VEdits& io_rEdits)
{
	for (std::size_t i = 0; i < i_rAfter.m_Segments.size(); ++i)
	{
		const auto& rBefore = i_rBefore.m_Segments[i].m_Joint;
		const auto& rAfter = i_rAfter.m_Segments[i].m_Joint;
		if (rBefore.m_JointType != rAfter.m_JointType)
			return false;
		if (rBefore.m_BindPose == rAfter.m_BindPose && rBefore.m_Mean == rAfter.m_Mean)
			continue;
		if (rAfter.m_Mean != rAfter.m_BindPose || rAfter.m_BindPose.empty()
		    || rAfter.m_BindPose.size() != CoreOrlexTypes::StateSize(rAfter.m_JointType))
			return false;
		std::string numbers;
		for (const double number : rAfter.m_BindPose)
			numbers += (numbers.empty() ? "" : ",") + NumberText::PrintShortest(number);
		io_rEdits.push_back(Command("pose", WordOf(i, i_rAfter) + "=" + numbers));
	}
	return true;
}

constexpr const char* c_SwitchSource = "switch-source";

bool IsFileCommand(const std::string& i_rName)
{
	return i_rName == c_SwitchSource || i_rName == c_FbxPoseCommand || i_rName == c_RebindFbxCommand
	    || i_rName == c_SkinCommand;
}

void TellIfChanged(const VReadFile& i_rFile, std::vector<std::string>& o_rChanged)
{
	if (!i_rFile.m_Path.empty() && ReadNow(i_rFile.m_Path).m_Written != i_rFile.m_Written)
		o_rChanged.push_back("'" + UtilsFileSystem::ToUtf8(i_rFile.m_Path)
		    + "' has changed since it was read here: the steps may give something else with it.");
}

} // namespace

VEdit EditAs(const char* i_pName, const char* i_pCommand, std::optional<std::string> i_Value)
{
	return {i_pName, 0, false, {Command(i_pCommand, std::move(i_Value))}};
}

VReadFile ReadNow(const boost::filesystem::path& i_rPath)
{
	boost::system::error_code error;
	return {i_rPath, boost::filesystem::last_write_time(i_rPath, error)};
}

VSessionStep::~VSessionStep()
{
	for (auto pStep = std::move(m_pBefore); pStep && pStep.use_count() == 1;)
		pStep = std::exchange(pStep->m_pBefore, nullptr);
}

std::string WordOf(std::size_t i_Segment, const VSubjectParametrised& i_rSubject)
{
	const std::string& rName = i_rSubject.m_Segments[i_Segment].m_Name;
	const bool bAlone = std::ranges::count(i_rSubject.m_Segments, rName, &VSubjectParametrised::VSegment::m_Name) == 1;
	return bAlone && !rName.empty() && rName.find_first_of("#:") == std::string::npos ? rName
	                                                                                  : "#" + std::to_string(i_Segment);
}

std::optional<VEdits> EditsBetween(
    const VSubjectValues& i_rBefore, const VSubjectValues& i_rAfter, const VSubjectParametrised* i_pSource)
{
	if (!i_rBefore.m_pParametrised || !i_rAfter.m_pParametrised)
		return std::nullopt;
	const VSubjectParametrised& rBefore = *i_rBefore.m_pParametrised;
	const VSubjectParametrised& rAfter = *i_rAfter.m_pParametrised;
	const std::size_t targets = rBefore.m_Targets.size();
	VEdits edits;
	if (rBefore.m_Segments.size() != rAfter.m_Segments.size() || rAfter.m_Targets.size() < targets
	    || !AddPoses(rBefore, rAfter, edits))
		return std::nullopt;
	for (std::size_t i = 0; i < targets; ++i)
		AddTargetChanges(rBefore, rAfter, i, edits);
	for (std::size_t i = targets; i < rAfter.m_Targets.size(); ++i)
		if (!AddTargetEdits(rAfter, i, i_pSource, edits))
			return std::nullopt;
	return edits;
}

VBeginning MadeOf(const VReadFile& i_rFbx, const FBXIO::VSkinSkeleton& i_rSkeleton, std::size_t i_Root,
    const std::string& i_rSourceName, double i_Scale, bool i_bPoseFromFile)
{
	const std::string& rName = i_rSkeleton[i_Root].m_Name;
	const bool bAlone = std::ranges::count(i_rSkeleton, rName, &FBXIO::VSkinBone::m_Name) == 1;
	VBeginning beginning{.m_Fbx = i_rFbx,
	    .m_Root = bAlone && !rName.empty() ? rName : "#" + std::to_string(i_Root),
	    .m_SourceName = i_rSourceName};
	if (i_Scale != 1.0)
		beginning.m_Edits.push_back(Command("scale", NumberText::PrintShortest(i_Scale)));
	if (i_bPoseFromFile)
		beginning.m_Edits.push_back(Command(c_FbxPoseCommand, UtilsFileSystem::ToUtf8(i_rFbx.m_Path)));
	return beginning;
}

VEdit AlignmentEdit(const VAlignmentChoice& i_rChoice, const VSubjectParametrised& i_rTarget)
{
	VEdit edit{Steps::c_Align};
	std::string chains;
	for (const auto& [pName, bWanted] : {std::pair("spine", i_rChoice.m_bSpine), {"arms", i_rChoice.m_bArms},
	         {"legs", i_rChoice.m_bLegs}, {"others", i_rChoice.m_bOthers}})
		if (bWanted)
			chains += (chains.empty() ? "" : ",") + std::string(pName);
	const bool bAll = i_rChoice.m_bSpine && i_rChoice.m_bArms && i_rChoice.m_bLegs && i_rChoice.m_bOthers;
	if (!bAll)
		edit.m_Commands.push_back(Command("chain", chains));
	for (const std::size_t segment : i_rChoice.m_Locked)
		edit.m_Commands.push_back(Command("lock", WordOf(segment, i_rTarget)));
	if (i_rChoice.m_bFeetWithShins)
		edit.m_Commands.push_back(Command("feet", "shins"));
	edit.m_Commands.push_back(Command("align"));
	if (i_rChoice.m_bFeetWithShins)
		edit.m_Commands.push_back(Command("feet", "level"));
	for (const std::size_t segment : i_rChoice.m_Locked)
		edit.m_Commands.push_back(Command("unlock", WordOf(segment, i_rTarget)));
	if (!bAll)
		edit.m_Commands.push_back(Command("chain", "all"));
	return edit;
}

void MakeRelative(SetupIO::VSetup& io_rRecipe, const boost::filesystem::path& i_rFolder)
{
	const auto make = [&](std::string& io_rPath)
	{
		const boost::filesystem::path path = UtilsFileSystem::PathFromUtf8(io_rPath);
		if (path.is_absolute() && path.root_name() == i_rFolder.root_name() && i_rFolder.is_absolute())
			io_rPath = UtilsFileSystem::ToUtf8(path.lexically_relative(i_rFolder));
	};
	for (std::string* const pPath :
	    {&io_rRecipe.m_Fbx, &io_rRecipe.m_Subject, &io_rRecipe.m_Source, &io_rRecipe.m_Output})
		make(*pPath);
	for (SetupIO::VEdit& rEdit : io_rRecipe.m_Edits)
		if (IsFileCommand(rEdit.m_Name))
			make(*rEdit.m_Value);
}

const VBeginning& BeginningOf(const VSessionStep& i_rLast)
{
	const VSessionStep* pStep = &i_rLast;
	while (!pStep->m_pBeginning)
		pStep = pStep->m_pBefore.get();
	return *pStep->m_pBeginning;
}

SetupIO::VSetup RecipeOf(const VSessionStep& i_rLast, std::vector<std::string>& o_rChanged)
{
	std::vector<const VSessionStep*> steps;
	for (const VSessionStep* pStep = &i_rLast; pStep; pStep = pStep->m_pBefore.get())
		steps.push_back(pStep);
	std::ranges::reverse(steps);
	const VBeginning& rBeginning = *steps.front()->m_pBeginning;
	SetupIO::VSetup recipe;
	recipe.m_Fbx = UtilsFileSystem::ToUtf8(rBeginning.m_Fbx.m_Path);
	TellIfChanged(rBeginning.m_Fbx, o_rChanged);
	recipe.m_Root = rBeginning.m_Root;
	if (rBeginning.m_bScaleRootHeight)
		recipe.m_RootHeight = "scale";
	if (!rBeginning.m_Subject.empty() && DigestOf(rBeginning.m_Subject) == rBeginning.m_Digest)
		recipe.m_Subject = UtilsFileSystem::ToUtf8(rBeginning.m_Subject);

	std::string fbx = recipe.m_Fbx;
	const auto add = [&](SetupIO::VEdit i_Edit)
	{
		if (i_Edit.m_Name == c_RebindFbxCommand)
			fbx = *i_Edit.m_Value;
		// Of a recipe that begins with a subject no file is the character's.
		else if (i_Edit.m_Name == c_FbxPoseCommand && std::exchange(fbx, *i_Edit.m_Value) == *i_Edit.m_Value
		    && !recipe.m_Fbx.empty())
			i_Edit = Command("match-file-pose");
		// What is so already need not be said.
		if (i_Edit.m_Name == c_SkinCommand && std::exchange(fbx, *i_Edit.m_Value) == *i_Edit.m_Value)
			return;
		if (i_Edit.m_Name == c_OnJointsCommand && std::exchange(fbx, {}).empty())
			return;
		recipe.m_Edits.push_back(std::move(i_Edit));
	};
	// The first is the source of the whole recipe.
	VReadFile source;
	for (const VSessionStep* const pStep : steps)
		if (source.m_Path.empty())
			source = pStep->m_Source;
	recipe.m_Source = UtilsFileSystem::ToUtf8(source.m_Path);
	TellIfChanged(source, o_rChanged);
	if (!recipe.m_Fbx.empty() && rBeginning.m_SourceName != FileStem(source.m_Path))
		add(Command("source-name", rBeginning.m_SourceName));
	for (const SetupIO::VEdit& rEdit : rBeginning.m_Edits)
		add(rEdit);
	for (const VSessionStep* const pStep : steps)
	{
		if (!pStep->m_Source.m_Path.empty() && pStep->m_Source.m_Path != source.m_Path)
		{
			source = pStep->m_Source;
			add(Command(c_SwitchSource, UtilsFileSystem::ToUtf8(source.m_Path)));
			TellIfChanged(source, o_rChanged);
		}
		for (const SetupIO::VEdit& rEdit : pStep->m_Edits)
			add(rEdit);
	}
	return recipe;
}

} // namespace RetargetSetup
