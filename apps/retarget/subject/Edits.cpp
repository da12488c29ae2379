#include "retarget/subject/Edits.h"

#include "CommandLineText/ExitStatus.h"
#include "CommandLineText/Messages.h"
#include "CommandLineText/Suggest.h"
#include "retarget/subject/Aligning.h"
#include "retarget/subject/Mapping.h"
#include "retarget/subject/Rebinding.h"
#include "retarget/subject/SetupFile.h"

#include "CoreOrlexTypes/JointType.h"
#include "CoreOrlexTypesUtils/convert/SubjectParametrisedConverter.h"
#include "DebugServices/GlobalLog.h"
#include "RetargetSetupCore/GlobalScale.h"
#include "RetargetSetupCore/Partner.h"
#include "RetargetSetupCore/RetargetTargets.h"
#include "RetargetSetupCore/RootHeight.h"
#include "SetupProposal/Side.h"
#include "math/NumberText.h"

#include <algorithm>
#include <iterator>
#include <numbers>
#include <sstream>

namespace CommandLine
{
namespace
{

using CoreOrlexTypes::VSubjectParametrised;

/// The index of the segment on the other side, -1 if there is none.
std::int32_t PartnerOf(
    const VSession::VPartners& i_rPartners, const VRetargetSetupCore::VSubjectValues& i_rValues, std::size_t i_Segment)
{
	for (auto it = i_rPartners.rbegin(); it != i_rPartners.rend(); ++it)
		if (it->first == i_Segment || it->second == i_Segment)
			return std::int32_t(it->first == i_Segment ? it->second : it->first);
	return RetargetSetup::FindPartner(*i_rValues.m_pParametrised, *i_rValues.m_pSubject, i_Segment);
}

void AddOneTarget(
    VSession& io_rSession, const std::string& i_rEdit, std::size_t i_Source, std::size_t i_Target, bool i_bPosition)
{
	const std::size_t before = io_rSession.Target().m_Targets.size();
	io_rSession.Document().AddTarget(int(i_Source), int(i_Target), i_bPosition, false);
	if (io_rSession.Target().m_Targets.size() == before)
		throw VCommandError(EBadInput, i_rEdit + ": the target could not be added");
}

void AddTarget(VSession& io_rSession, const std::string& i_rPair, bool i_bPosition)
{
	const std::string option = i_bPosition ? "--position" : "--rotation";
	const VSubjectParametrised& rSource = io_rSession.Source(option);
	const auto [source, target] =
	    FindPair(i_rPair, SegmentsOf(rSource, "source segment"), SegmentsOf(io_rSession.Target(), "target segment"));
	const std::string edit = option + " " + i_rPair;
	AddOneTarget(io_rSession, edit, source, target, i_bPosition);
	if (!io_rSession.m_bSymmetry)
		return;
	const std::string& rSourceName = rSource.m_Segments[source].m_Name;
	const std::string& rTargetName = io_rSession.Target().m_Segments[target].m_Name;
	const std::int32_t sourcePartner =
	    PartnerOf(io_rSession.m_SourcePartners, io_rSession.Document().SourceValues(), source);
	const std::int32_t targetPartner =
	    PartnerOf(io_rSession.m_TargetPartners, io_rSession.Document().TargetValues(), target);
	if (sourcePartner != -1 && targetPartner != -1)
		return AddOneTarget(io_rSession, edit, std::size_t(sourcePartner), std::size_t(targetPartner), i_bPosition);
	const auto hasSide = [](const std::string& i_rName)
	{ return SetupProposal::SideOfName(i_rName) != SetupProposal::ESide::None; };
	const std::string sentence = edit + ": " + (sourcePartner == -1 ? "the source segment \"" + rSourceName + "\"" : "")
	    + (sourcePartner == -1 && targetPartner == -1 ? " and " : "")
	    + (targetPartner == -1 ? "the target segment \"" + rTargetName + "\"" : "")
	    + " has no partner on the other side";
	if (hasSide(rSourceName) && hasSide(rTargetName))
		io_rSession.m_WithoutPartner.push_back(sentence);
	else
		NVX_LOG(c_pCategory, NVX::ELogInformation, "%1%: the target is added alone", sentence);
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

void Pair(VSession& io_rSession, const std::string& i_rPair)
{
	if (i_rPair.starts_with('#') || i_rPair.find(":#") != std::string::npos)
		throw VCommandError(EWrongUsage,
		    "--pair " + i_rPair + ": segments are given by name, since an index means one of each skeleton");
	const auto add = [&](const VSubjectParametrised& i_rSubject, const char* i_pKind, VSession::VPartners& io_rPartners)
	{
		const VElements segments = SegmentsOf(i_rSubject, i_pKind);
		io_rPartners.push_back(FindPair(i_rPair, segments, segments));
	};
	bool bOfSource = false;
	if (const auto pSource = io_rSession.Document().SourceValues().m_pParametrised)
	{
		try
		{
			add(*pSource, "source segment", io_rSession.m_SourcePartners);
			bOfSource = true;
		}
		catch (const VCommandError&)
		{
			// Then they are the target's, or it tells what is wrong.
		}
	}
	try
	{
		add(io_rSession.Target(), "target segment", io_rSession.m_TargetPartners);
	}
	catch (const VCommandError&)
	{
		if (!bOfSource)
			throw;
	}
}

void AllowPartial(VSession& io_rSession, const std::string&)
{
	io_rSession.m_bAllowPartial = true;
}

void Auto(VSession& io_rSession, const std::string&)
{
	AddProposedTargets(io_rSession);
}

void Preset(VSession& io_rSession, const std::string& i_rPath)
{
	ApplyPreset(io_rSession, i_rPath);
}

void MinimumScore(VSession& io_rSession, const std::string& i_rScore)
{
	io_rSession.m_MinimumScore = ParseScore(i_rScore);
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

/// What stands between commas, as it stands.
std::vector<std::string> SplitAtCommas(const std::string& i_rText)
{
	std::vector<std::string> parts{""};
	for (const char byte : i_rText)
		if (byte == ',')
			parts.emplace_back();
		else
			parts.back() += byte;
	return parts;
}

void SetExpressions(VSession& io_rSession, const std::string& i_rValue)
{
	const std::size_t at = i_rValue.find('=');
	const std::vector<std::string> texts = SplitAtCommas(at == std::string::npos ? "" : i_rValue.substr(at + 1));
	if (texts.size() != 3)
		throw VCommandError(EWrongUsage, "--expressions: \"" + i_rValue + "\" is not TARGET=X,Y,Z");
	VSubjectParametrised subject = io_rSession.Target();
	const std::size_t index = ParseIndex(i_rValue.substr(0, at), "target", subject.m_Targets.size());
	for (std::size_t i = 0; i < 3; ++i)
		if (!texts[i].empty() && !RetargetSetup::SetStateExpression(subject, texts[i], index, i))
			throw VCommandError(
			    EWrongUsage, "--expressions: target #" + std::to_string(index) + " cannot take \"" + texts[i] + "\"");
	io_rSession.Document().SetTargetSubjectParametrised(subject);
}

void SetScale(VSession& io_rSession, const std::string& i_rValue)
{
	if (i_rValue == "keep")
		return;
	const double scale = i_rValue == "fit" ? ScaleThatFits(io_rSession) : ParseFinite(i_rValue, "--scale");
	if (!(scale > 0.0))
		throw VCommandError(EWrongUsage, "--scale: a scale must be above 0: " + i_rValue);
	io_rSession.Document().SetTargetScale(scale);
	if (io_rSession.Document().GetTargetScale() != scale)
		throw VCommandError(EWrongUsage,
		    "--scale: the scale stays: another one takes the place of the dynamic parameters '"
		        + RetargetSetup::LostParameters(io_rSession.Target()) + "', which the target subject needs");
}

void CreateJoints(VSession& io_rSession, const std::string&)
{
	io_rSession.Document().CreateAllJoints();
}

void TellPrunedBehindMatch(const VSession& i_rSession, const char* i_pOption)
{
	if (i_rSession.m_bMatched)
		NVX_LOG(c_pCategory, NVX::ELogWarning,
		    "%1% after --match-file-pose: pruning moves what was matched; put --match-file-pose behind it", i_pOption);
}

void PruneJoints(VSession& io_rSession, const std::string&)
{
	TellPrunedBehindMatch(io_rSession, "--prune-joints");
	io_rSession.Document().RemoveUnnecessaryJoints();
}

void PruneJoint(VSession& io_rSession, const std::string& i_rSegment)
{
	const VSubjectParametrised& rSubject = io_rSession.Target();
	const std::size_t segment = FindElement(i_rSegment, SegmentsOf(rSubject, "target segment"));
	const auto& rSegment = rSubject.m_Segments[segment];
	if (segment == 0 || rSegment.m_Joint.m_JointType == VSubjectParametrised::VJoint::EDummy)
		throw VCommandError(EWrongUsage,
		    "--prune-joint: \"" + rSegment.m_Name
		        + (segment == 0 ? "\" is the root, whose joint stays" : "\" has no joint that could go"));
	TellPrunedBehindMatch(io_rSession, "--prune-joint");
	io_rSession.Document().RemoveJoint(std::int32_t(segment));
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

void MoveRoot(VSession& io_rSession, const char* i_pEdit, const std::function<void(Rotation::VPose<double>&)>& i_rMove)
{
	VSubjectParametrised subject = io_rSession.Target();
	if (!RetargetSetup::MoveRoot(subject, i_rMove))
		throw VCommandError(
		    EBadInput, std::string(i_pEdit) + ": the root of the target subject has no place that could change");
	io_rSession.Document().SetTargetSubjectParametrised(subject);
}

void Turn(VSession& io_rSession, const std::string& i_rDegrees)
{
	const double angle = ParseFinite(i_rDegrees, "--turn") * std::numbers::pi / 180.0;
	MoveRoot(io_rSession, "--turn",
	    [&](Rotation::VPose<double>& io_rWorld) {
		    io_rWorld.R = Rotation::Product(Rotation::RotationMatrixFromAngleAxis({0.0, 0.0, angle}), io_rWorld.R);
	    });
}

void Lift(VSession& io_rSession, const std::string& i_rMm)
{
	const double mm = ParseFinite(i_rMm, "--lift");
	MoveRoot(io_rSession, "--lift", [&](Rotation::VPose<double>& io_rWorld) { io_rWorld.t[2] += mm; });
}

void MatchFilePose(VSession& io_rSession, const std::string&)
{
	io_rSession.MatchFilePose();
}

void FbxPose(VSession& io_rSession, const std::string& i_rPath)
{
	io_rSession.LoadFbx(i_rPath);
	io_rSession.MatchFilePose();
}

void StandOnSkin(VSession& io_rSession, const std::string& i_rPath)
{
	io_rSession.LoadFbx(i_rPath);
}

void SwitchSource(VSession& io_rSession, const std::string& i_rPath)
{
	io_rSession.LoadSource(i_rPath);
}

void NameSource(VSession& io_rSession, const std::string& i_rName)
{
	io_rSession.NameSource(i_rName);
}

void SwitchRootHeight(VSession& io_rSession, const std::string& i_rWord)
{
	if (i_rWord != "keep" && i_rWord != c_pScaleRootHeight)
		throw VCommandError(EWrongUsage, "--switch-root-height: keep or scale, not \"" + i_rWord + "\"");
	io_rSession.Document().SetScaleRootHeight(i_rWord == c_pScaleRootHeight);
}

void Align(VSession& io_rSession, const std::string&)
{
	AlignTarget(io_rSession);
}

void UpdateTargets(VSession& io_rSession, const std::string&)
{
	io_rSession.Source("--update-targets");
	io_rSession.Document().UpdateTargets();
}

void MeasureAgain(VSession& io_rSession)
{
	io_rSession.Document().UpdateTargets();
	constexpr const char* c_pText =
	    "The offsets that --auto measured were measured again at the new scale, as --update-targets does";
	NVX_LOG(c_pCategory, NVX::ELogInformation, "%1%", c_pText);
	io_rSession.m_ReportText += std::string(c_pText) + "\n";
}

constexpr const char* c_pEditsGroup = "Edits, run in the order given";

constexpr VEditKind c_Kinds[] = {
    {"--position", "SRC:TGT",
        "Add a position target: a point fixed to the target segment TGT follows the source segment SRC. Segments are "
        "given by name, without a namespace, or as #index",
        AddPosition},
    {"--rotation", "SRC:TGT",
        "Add a rotation target: the orientation of the target segment TGT follows the source segment SRC", AddRotation},
    {"--symmetry", nullptr, "From here on, a target that is added gets its left or right partner too", SymmetryOn},
    {"--no-symmetry", nullptr, "From here on, a target is added alone (the default)", SymmetryOff},
    {"--pair", "LEFT:RIGHT",
        "From here on, the segments LEFT and RIGHT are each other's partner, whatever their names say: of the source, "
        "of "
        "the target, or of both where both have them",
        Pair},
    {"--allow-partial", nullptr,
        "Let a target of one side, wherever it stands, go without a partner where none is found, and go without what "
        "re-binding cannot keep; without this it is an error (exit status 1)",
        AllowPartial},
    {"--auto", nullptr,
        "Add targets for all pairs of segments that \"retarget map\" proposes, with the kinds and weights that it "
        "suggests; a pair that has such a target keeps it",
        Auto},
    {"--preset", "FILE",
        "Add targets for the pairs of a preset: by names or, where one is not there, by what \"retarget map\" "
        "proposes. "
        "What does not fit is listed; a pair that has such a target keeps it",
        Preset, false, true},
    {"--min-score", "SCORE", "From here on, --auto takes no pair that scores less: from 0 to 1, at first 0.5",
        MinimumScore},
    {"--remove-target", "N", "Remove target N; those behind it move up by one", RemoveTarget},
    {"--weight", "N=W", "Give target N the weight W", SetWeight},
    {"--state", "N=X,Y,Z",
        "Give target N the offset X,Y,Z: mm at the present scale (position) or an angle-axis in radians (rotation)",
        SetState},
    {"--expressions", "N=X,Y,Z",
        "Give target N the offset X,Y,Z as the fields of the panel take it: an angle may be an expression, and what is "
        "left empty stays",
        SetExpressions},
    {"--scale", "S|fit|keep",
        "Scale all lengths of the target subject: 1 is the size in the file, fit brings the hips to the height of the "
        "source's, keep leaves it. Where neither this nor --root-height is given, --auto with --align fits it, and the "
        "height of the root, if hips differ by more than 2 %",
        SetScale},
    {"--switch-root-height", "keep|scale",
        "From here on, and at once, what the scale does to the height of the root above the floor, as --root-height",
        SwitchRootHeight},
    {"--create-joints", nullptr, "Give every segment without a joint a ball joint", CreateJoints},
    {"--prune-joints", nullptr, "Remove the joints of segments that carry no target", PruneJoints},
    {"--prune-joint", "SEGMENT",
        "Remove the joint of the target segment SEGMENT alone, whether it carries a target or not; \"retarget advise\" "
        "tells which could go",
        PruneJoint},
    {"--pose", "SEG=RX,RY,RZ[,TX,TY,TZ]",
        "Set the bind pose of the target segment SEG: an angle-axis in radians, for the root a translation in mm too",
        Pose},
    {"--turn", "DEGREES",
        "Turn the target subject in its bind pose about the vertical through its root, to the left as seen from above",
        Turn},
    {"--lift", "MM", "Lift the root of the target subject in its bind pose; negative lowers it", Lift},
    {"--align", nullptr,
        "Bring the bind pose of the target subject to the source's: each segment that a target ties points where the "
        "source's points, the whole faces where the source faces, and the feet stand on the floor; then measure all "
        "offsets again. A subject that stands as it was made takes the pose of the FBX file first",
        Align},
    {"--lock", "SEGMENT", "From here on, --align leaves the joint of the target segment SEGMENT as it is", LockSegment},
    {"--unlock", "SEGMENT", "From here on, --align turns the joint of the target segment SEGMENT again", UnlockSegment},
    {"--chain", "arms|legs|spine|others|all",
        "From here on, --align reaches only the arms, the legs, the spine with neck, pelvis and facing, or what is no "
        "part of a body; several are separated by commas (at first all)",
        ChooseChain},
    {"--feet", "level|shins",
        "From here on, --align lets the feet keep their tilt (level, at first), or lean as the shins do (shins): for a "
        "performer whose legs are splayed in its bind pose, and whose soles are with them",
        ChooseFeet},
    {"--as-it-stands", nullptr, "From here on, --align begins with no other pose than the one that stands there",
        AlignAsItStands},
    {"--skin", "FILE",
        "From here on, --align lets the character stand on the skin of its FBX file FILE, which a saved retarget "
        "subject has none of",
        StandOnSkin, false, true},
    {"--on-joints", nullptr, "From here on, --align lets the character stand on its joints, without a look at its skin",
        StandOnJoints},
    {"--match-file-pose", nullptr,
        "Set all bind poses so that the segments stand as the bones do in the FBX file; belongs after --prune-joints",
        MatchFilePose, true},
    {"--fbx-pose", "FILE",
        "As --match-file-pose, by the character's FBX file FILE, which a saved retarget subject has none of", FbxPose,
        false, true},
    {"--rebind-fbx", "FILE",
        "Take all over to the character's changed FBX file FILE, as \"retarget rebind\" does; what could not be kept "
        "is "
        "an error (exit status 1) without --allow-partial",
        RebindFbx, false, true},
    {"--rebind-source", nullptr,
        "Take the targets over to the source that there is, another performer, as \"retarget rebind\" does; offsets "
        "stay, --update-targets behind it measures them",
        RebindSource},
    {"--switch-source", "FILE.qrs", "From here on, the source is FILE.qrs", SwitchSource, false, true},
    {"--source-name", "NAME",
        "Save NAME as the source that the subject is made for, in place of the one that it was made with", NameSource},
    {"--update-targets", nullptr, "Measure the offset of every target again in the present bind poses", UpdateTargets},
};

std::string Trimmed(const std::string& i_rText)
{
	constexpr const char* c_Blanks = " \t\r";
	const std::size_t begin = i_rText.find_first_not_of(c_Blanks);
	return begin == std::string::npos ? "" : i_rText.substr(begin, i_rText.find_last_not_of(c_Blanks) + 1 - begin);
}

/// By its name, with dashes. Throws VCommandError with EBadInput if there is none.
const VEditKind& FindKind(const std::string& i_rName, bool i_bOfCreate, const std::string& i_rWhere)
{
	const auto pKind = std::find_if(std::begin(c_Kinds), std::end(c_Kinds),
	    [&](const VEditKind& i_rKind) { return i_rName == i_rKind.m_pName && (i_bOfCreate || !i_rKind.m_bOfCreate); });
	if (pKind != std::end(c_Kinds))
		return *pKind;
	std::vector<std::string> names;
	for (const VEditKind& rKind : c_Kinds)
		names.push_back(rKind.m_pName);
	throw VCommandError(EBadInput, i_rWhere + "there is no edit \"" + i_rName + "\"" + Meant(i_rName, names));
}

VEdit MakeEdit(const std::string& i_rName, const std::optional<std::string>& i_rValue, const std::string& i_rPath,
    std::size_t i_Line, bool i_bOfCreate)
{
	const std::string where = i_rPath + ":" + std::to_string(i_Line) + ": ";
	const VEditKind& rKind = FindKind(i_rName, i_bOfCreate, where);
	if (i_rValue.has_value() == (rKind.m_pValue == nullptr))
		throw VCommandError(EBadInput,
		    where + i_rName + (i_rValue ? " takes no value" : std::string(" needs a value: ") + rKind.m_pValue));
	VEdit edit{&rKind, i_rValue.value_or(""), where};
	if (rKind.m_bFile)
		edit.m_Value = PathBeside(i_rPath, edit.m_Value);
	return edit;
}

/// One edit a line, as on the command line but without quotes: what stands behind the option's name is its value,
/// blanks and all. Empty lines and those that begin with "#" are passed over.
void ReadLines(const std::string& i_rText, const std::string& i_rPath, bool i_bOfCreate, VEdits& io_rEdits)
{
	std::istringstream stream(i_rText);
	std::size_t number = 0;
	for (std::string line; std::getline(stream, line);)
	{
		++number;
		line = Trimmed(line);
		if (line.empty() || line[0] == '#')
			continue;
		const std::size_t split = std::min(line.find_first_of(" \t="), line.size());
		const std::string value = split == line.size() ? "" : Trimmed(line.substr(split + 1));
		io_rEdits.push_back(MakeEdit(
		    line.substr(0, split), value.empty() ? std::nullopt : std::optional(value), i_rPath, number, i_bOfCreate));
	}
}

/// JSON, or lines of text.
void ReadEdits(const std::string& i_rPath, bool i_bOfCreate, VEdits& io_rEdits)
{
	const std::string text = ReadSetupText(i_rPath, "a file of edits");
	const std::size_t first = text.find_first_not_of(" \t\r\n");
	if (first == std::string::npos || text[first] != '{')
		return ReadLines(text, i_rPath, i_bOfCreate, io_rEdits);
	const SetupIO::VSetup setup = ParseSetup(text, i_rPath, {"pairs", "edits"}, "a file of edits");
	for (VEdit& rEdit : EditsOf(setup, i_rPath, i_bOfCreate))
		io_rEdits.push_back(std::move(rEdit));
}

void AddPair(VSession& io_rSession, const SetupIO::VPair& i_rPair)
{
	const std::string what = "the pair of \"" + i_rPair.m_Source + "\" and \"" + i_rPair.m_Target + "\"";
	const std::size_t source = FindElement(i_rPair.m_Source, SegmentsOf(io_rSession.Source(what), "source segment"));
	const std::size_t target = FindElement(i_rPair.m_Target, SegmentsOf(io_rSession.Target(), "target segment"));
	AddPairTargets(io_rSession, i_rPair, source, target);
}

/// What was told at loading and behind each edit of expressions that do not evaluate is forgotten for what is true of
/// the target subject in the end. Of a performer only states of targets can fail, which nothing here asks for.
void TellExpressionsAgain(const VRetargetSetupCore& i_rDocument)
{
	ForgetMessages([](const std::string& i_rCategory, const std::string&) { return i_rCategory == "SubjectUtils"; });
	CoreOrlexTypes::VSubject subject;
	CoreOrlexTypesUtils::SubjectParametrisedConverter::ConvertSubject(
	    *i_rDocument.TargetValues().m_pParametrised, subject);
}

} // namespace

VEdits EditsOf(const SetupIO::VSetup& i_rSetup, const std::string& i_rPath, bool i_bOfCreate)
{
	VEdits edits;
	for (const SetupIO::VPair& rPair : i_rSetup.m_Pairs)
		edits.push_back({nullptr, {}, i_rPath + ":" + std::to_string(rPair.m_Line.m_Value) + ": ", rPair});
	for (const SetupIO::VEdit& rEdit : i_rSetup.m_Edits)
		edits.push_back(MakeEdit("--" + rEdit.m_Name, rEdit.m_Value, i_rPath, rEdit.m_Line.m_Value, i_bOfCreate));
	return edits;
}

std::vector<SetupIO::VEditForm> EditForms()
{
	std::vector<SetupIO::VEditForm> forms;
	for (const VEditKind& rKind : c_Kinds)
		forms.push_back({std::string(rKind.m_pName).substr(2), rKind.m_pValue != nullptr, rKind.m_pHelp});
	return forms;
}

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
				                  i_rpEdits->push_back({&rKind, i_rValue, {}});
			                  },
			                  rKind.m_pHelp)
			              ->option_text(rKind.m_pValue);
		else
			pOption = io_rApp.add_flag_callback(
			    rKind.m_pName,
			    [i_rpEdits, &rKind] {
				    i_rpEdits->push_back({&rKind, {}, {}});
			    },
			    rKind.m_pHelp);
		// While parsing, so that options of different names keep their order.
		pOption->trigger_on_parse()->group(c_pEditsGroup);
	}
	io_rApp
	    .add_option_function<std::string>(
	        "--edits",
	        [i_rpEdits, i_bOfCreate](const std::string& i_rPath) { ReadEdits(i_rPath, i_bOfCreate, *i_rpEdits); },
	        "Here come the pairs and edits of a file in the form that \"retarget schema setup\" tells, or of one edit "
	        "a "
	        "line, as --position Hips:Left Hip, without quotes, where # begins comments; - is standard input")
	    ->option_text("FILE")
	    ->trigger_on_parse()
	    ->group(c_pEditsGroup);
}

bool TakesProposal(const VEdits& i_rEdits)
{
	return std::ranges::any_of(i_rEdits,
	    [](const VEdit& i_rEdit)
	    {
		    const auto* const pKind = i_rEdit.m_pKind;
		    return pKind && (pKind->m_pApply == Auto || pKind->m_pApply == Preset);
	    });
}

bool LeavesScale(const VEdits& i_rEdits)
{
	const auto has = [&](auto* i_pApply, bool i_bTyped)
	{
		return std::ranges::any_of(i_rEdits,
		    [&](const VEdit& i_rEdit) {
			    return i_rEdit.m_pKind && i_rEdit.m_pKind->m_pApply == i_pApply
			        && (!i_bTyped || i_rEdit.m_Where.empty());
		    });
	};
	return has(Auto, true) && has(Align, true) && !has(SetScale, false) && !has(SwitchRootHeight, false);
}

void AddRootHeightOption(CLI::App& io_rApp, std::string& o_rWord)
{
	io_rApp
	    .add_option("--root-height", o_rWord,
	        "What the scale does to the height of the root above the floor: keep leaves it, scale scales it, too, so "
	        "that "
	        "the feet stay on the floor")
	    ->option_text("keep|scale")
	    ->check(CLI::IsMember({"keep", c_pScaleRootHeight}));
}

void ApplyEdits(VSession& io_rSession, const VEdits& i_rEdits)
{
	bool bMeasured = false;
	for (const VEdit& rEdit : i_rEdits)
	{
		const auto is = [&](auto* i_pApply) { return rEdit.m_pKind && rEdit.m_pKind->m_pApply == i_pApply; };
		bMeasured = (bMeasured || is(Auto)) && !is(SetState) && !is(SetExpressions);
		const double scale = io_rSession.Document().GetTargetScale();
		try
		{
			if (rEdit.m_pKind)
				rEdit.m_pKind->m_pApply(io_rSession, rEdit.m_Value);
			else
				AddPair(io_rSession, rEdit.m_Pair);
		}
		catch (const VCommandError& rError)
		{
			throw VCommandError(rError.Status(), rEdit.m_Where + rError.what());
		}
		if (bMeasured && io_rSession.m_bOffsetsFollowScale && io_rSession.Document().GetTargetScale() != scale
		    && !is(Align))
			MeasureAgain(io_rSession);
		io_rSession.Settle();
	}
	TellExpressionsAgain(io_rSession.Document());
	const std::vector<std::string>& rWithoutPartner = io_rSession.m_WithoutPartner;
	const bool bPartial = io_rSession.m_bAllowPartial;
	for (const std::string& rSentence : rWithoutPartner)
		NVX_LOG(c_pCategory, bPartial ? NVX::ELogWarning : NVX::ELogError, "%1%", rSentence);
	for (const std::string& rLost : io_rSession.m_Lost)
		NVX_LOG(c_pCategory, bPartial ? NVX::ELogWarning : NVX::ELogError, "Not kept: %1%", rLost);
	if (!io_rSession.m_Lost.empty() && !bPartial)
		throw VCommandError(EFindings, "Re-binding could not keep all: --allow-partial goes without");
	if (!rWithoutPartner.empty() && !bPartial)
		throw VCommandError(EFindings,
		    "--symmetry found no partner for " + std::to_string(rWithoutPartner.size())
		        + " of the targets: give it with --pair LEFT:RIGHT, add those with --no-symmetry, or go without with "
		          "--allow-partial");
}

} // namespace CommandLine
