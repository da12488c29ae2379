#include "retarget/Edits.h"

#include "retarget/ExitStatus.h"
#include "retarget/Messages.h"

#include "CoreOrlexTypes/JointType.h"
#include "DebugServices/GlobalLog.h"
#include "RetargetSetupDocument/FilePose.h"
#include "RetargetSetupDocument/RetargetTargets.h"
#include "math/NumberText.h"

#include <algorithm>

namespace CommandLine
{
namespace
{

using CoreOrlexTypes::VSubjectParametrised;

void AddTarget(VSession& io_rSession, const std::string& i_rPair, bool i_bPosition)
{
	const std::string option = i_bPosition ? "--position" : "--rotation";
	const auto [source, target] = FindPair(i_rPair, SegmentsOf(io_rSession.Source(option), "source segment"),
	    SegmentsOf(io_rSession.Target(), "target segment"));
	const std::size_t before = io_rSession.Target().m_Targets.size();
	io_rSession.Document().AddTarget(int(source), int(target), i_bPosition, io_rSession.m_bSymmetry);
	if (io_rSession.Target().m_Targets.size() == before)
		throw VCommandError(EBadInput, option + " " + i_rPair + ": the target could not be added");
}

void AddPosition(VSession& io_rSession, const std::string& i_rPair)
{
	AddTarget(io_rSession, i_rPair, true);
}

void AddRotation(VSession& io_rSession, const std::string& i_rPair)
{
	AddTarget(io_rSession, i_rPair, false);
}

void SymmetryOn(VSession& io_rSession, const std::string&)
{
	io_rSession.m_bSymmetry = true;
}

void SymmetryOff(VSession& io_rSession, const std::string&)
{
	io_rSession.m_bSymmetry = false;
}

void RemoveTarget(VSession& io_rSession, const std::string& i_rIndex)
{
	io_rSession.Document().RemoveTarget(int(ParseIndex(i_rIndex, "target", io_rSession.Target().m_Targets.size())));
}

void SetWeight(VSession& io_rSession, const std::string& i_rValue)
{
	const auto [index, weight] = SplitAssignment(i_rValue, "TARGET=WEIGHT");
	VSubjectParametrised subject = io_rSession.Target();
	auto& rTarget = subject.m_Targets[ParseIndex(index, "target", subject.m_Targets.size())];
	rTarget.m_Weight = ParseFinite(weight, "--weight");
	if (rTarget.m_Weight < 0.0)
		throw VCommandError(EWrongUsage, "--weight: a weight cannot be negative: " + weight);
	io_rSession.Document().SetTargetSubjectParametrised(subject);
}

void SetState(VSession& io_rSession, const std::string& i_rValue)
{
	const auto [word, list] = SplitAssignment(i_rValue, "TARGET=X,Y,Z");
	VSubjectParametrised subject = io_rSession.Target();
	const std::size_t index = ParseIndex(word, "target", subject.m_Targets.size());
	const std::vector<double> values = ParseList(list, "--state");
	if (values.size() != 3)
		throw VCommandError(EWrongUsage, "--state: \"" + list + "\" is not three numbers");
	for (std::size_t i = 0; i < 3; ++i)
		if (!RetargetSetup::SetStateExpression(subject, NumberText::PrintG17(values[i]), index, i))
			throw VCommandError(
			    EWrongUsage, "--state: target #" + std::to_string(index) + " cannot take \"" + list + "\"");
	io_rSession.Document().SetTargetSubjectParametrised(subject);
}

void SetScale(VSession& io_rSession, const std::string& i_rValue)
{
	const double scale = ParseFinite(i_rValue, "--scale");
	if (!(scale > 0.0))
		throw VCommandError(EWrongUsage, "--scale: a scale must be above 0: " + i_rValue);
	io_rSession.Document().SetTargetScale(scale);
}

void CreateJoints(VSession& io_rSession, const std::string&)
{
	io_rSession.Document().CreateAllJoints();
}

void PruneJoints(VSession& io_rSession, const std::string&)
{
	if (io_rSession.m_bMatched)
		NVX_LOG(c_pCategory, NVX::ELogWarning,
		    "--prune-joints after --match-file-pose: pruning moves what was matched; put --match-file-pose behind it");
	io_rSession.Document().RemoveUnnecessaryJoints();
}

void Pose(VSession& io_rSession, const std::string& i_rValue)
{
	const auto [word, list] = SplitAssignment(i_rValue, "SEGMENT=rx,ry,rz[,tx,ty,tz]");
	VSubjectParametrised subject = io_rSession.Target();
	const std::size_t index = FindElement(word, SegmentsOf(subject, "target segment"));
	auto& rJoint = subject.m_Segments[index].m_Joint;
	const std::size_t size = CoreOrlexTypes::StateSize(rJoint.m_JointType);
	const std::vector<double> values = ParseList(list, "--pose");
	if (size == 0)
		throw VCommandError(EWrongUsage,
		    "--pose: \"" + subject.m_Segments[index].m_Name
		        + "\" has no joint that could move; --create-joints before it gives it one");
	if (values.size() != std::min<std::size_t>(size, 3) && values.size() != size)
		throw VCommandError(EWrongUsage,
		    "--pose: the joint of \"" + subject.m_Segments[index].m_Name + "\" takes " + (size > 3 ? "3 or " : "")
		        + std::to_string(size) + " numbers, not " + std::to_string(values.size()));
	// A rotation alone leaves the root where it is.
	rJoint.m_BindPose.resize(size);
	std::copy(values.begin(), values.end(), rJoint.m_BindPose.begin());
	rJoint.m_Mean = rJoint.m_BindPose;
	io_rSession.Document().SetTargetSubjectParametrised(subject);
}

void MatchFilePose(VSession& io_rSession, const std::string&)
{
	const VCharacterFile& rFile = *io_rSession.File();
	VSubjectParametrised subject = io_rSession.Target();
	const RetargetSetup::VFileMatch match = RetargetSetup::MatchFilePose(subject, rFile.m_Bones, rFile.m_Axis);
	io_rSession.Document().SetTargetSubjectParametrised(subject);
	io_rSession.m_bMatched = true;
	if (!match.m_Lengths.empty())
		NVX_LOG(c_pCategory, NVX::ELogInformation, "--match-file-pose: %1% segments got the file's lengths",
		    match.m_Lengths.size());
	if (!match.m_PreRotations.empty())
		NVX_LOG(c_pCategory, NVX::ELogInformation, "--match-file-pose: %1% segments without a joint were turned",
		    match.m_PreRotations.size());
	// What lengths within a thousandth of the file's add up to is no concern.
	if (const auto worst = DifferenceFromFile(io_rSession))
		TellDifferenceFromFile(io_rSession, *worst,
		    worst->m_Distance > 1.0 || worst->m_Angle > 1e-3 ? NVX::ELogWarning : NVX::ELogInformation,
		    "After --match-file-pose the bind pose", "");
}

void UpdateTargets(VSession& io_rSession, const std::string&)
{
	io_rSession.Source("--update-targets");
	io_rSession.Document().UpdateTargets();
}

constexpr VEditKind c_Kinds[] = {
    {"--position", "SRC:TGT",
        "Add a position target: a point fixed to the target segment TGT follows the source segment SRC. Segments are "
        "given by name, without a namespace, or as #index",
        AddPosition},
    {"--rotation", "SRC:TGT",
        "Add a rotation target: the orientation of the target segment TGT follows the source segment SRC", AddRotation},
    {"--symmetry", nullptr, "From here on, a target that is added gets its left or right partner too", SymmetryOn},
    {"--no-symmetry", nullptr, "From here on, a target is added alone (the default)", SymmetryOff},
    {"--remove-target", "N", "Remove target N; those behind it move up by one", RemoveTarget},
    {"--weight", "N=W", "Give target N the weight W", SetWeight},
    {"--state", "N=X,Y,Z",
        "Give target N the offset X,Y,Z: mm at the present scale (position) or an angle-axis in radians (rotation)",
        SetState},
    {"--scale", "S", "Scale all lengths of the target subject: 1 is the size in the file", SetScale},
    {"--create-joints", nullptr, "Give every segment without a joint a ball joint", CreateJoints},
    {"--prune-joints", nullptr, "Remove the joints of segments that carry no target", PruneJoints},
    {"--pose", "SEG=RX,RY,RZ[,TX,TY,TZ]",
        "Set the bind pose of the target segment SEG: an angle-axis in radians, for the root a translation in mm too",
        Pose},
    {"--match-file-pose", nullptr,
        "Set all bind poses so that the segments stand as the bones do in the FBX file; belongs after --prune-joints",
        MatchFilePose, true},
    {"--update-targets", nullptr, "Measure the offset of every target again in the present bind poses", UpdateTargets},
};

} // namespace

void AddEditOptions(CLI::App& io_rApp, const std::shared_ptr<VEdits>& i_rpEdits, bool i_bOfCreate)
{
	for (const VEditKind& rKind : c_Kinds)
	{
		if (rKind.m_bOfCreate && !i_bOfCreate)
			continue;
		CLI::Option* pOption = nullptr;
		if (rKind.m_pValue)
			pOption = io_rApp
			              .add_option_function<std::string>(
			                  rKind.m_pName,
			                  [i_rpEdits, &rKind](const std::string& i_rValue) {
				                  i_rpEdits->push_back({&rKind, i_rValue});
			                  },
			                  rKind.m_pHelp)
			              ->option_text(rKind.m_pValue);
		else
			pOption = io_rApp.add_flag_callback(
			    rKind.m_pName,
			    [i_rpEdits, &rKind] {
				    i_rpEdits->push_back({&rKind, {}});
			    },
			    rKind.m_pHelp);
		// While parsing, so that options of different names keep their order.
		pOption->trigger_on_parse()->group("Edits, run in the order given");
	}
}

void ApplyEdits(VSession& io_rSession, const VEdits& i_rEdits)
{
	for (const VEdit& rEdit : i_rEdits)
	{
		rEdit.m_pKind->m_pApply(io_rSession, rEdit.m_Value);
		io_rSession.Settle();
	}
}

} // namespace CommandLine
