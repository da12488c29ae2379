#include "TakeSolve/Performer.h"

#include "TakeSolve/Vectors.h"

#include "CoreOrlexTypes/JointType.h"
#include "SetupProposal/Side.h"
#include "math/NumberText.h"

#include <set>

namespace TakeSolve
{
namespace
{

using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;
using TakeIO::VJoint;
using TakeIO::VTake;
using VSubjectJoint = VSubjectParametrised::VJoint;

/// A bone that is shorter has no direction, in mm.
constexpr double c_NoLength = 1e-3;
/// Blue to the left, orange to the right.
constexpr CoreOrlexTypes::VColour c_LeftColour{0, 128, 255, 255};
constexpr CoreOrlexTypes::VColour c_RightColour{255, 96, 0, 255};

/// By joints, the root of each and the number of joints that hang on that.
struct VTrees
{
	explicit VTrees(const VTake& i_rTake) : m_Counts(i_rTake.m_Joints.size(), 0)
	{
		for (const VJoint& rJoint : i_rTake.m_Joints)
		{
			m_Roots.push_back(rJoint.m_Parent < 0 ? m_Roots.size() : m_Roots[std::size_t(rJoint.m_Parent)]);
			++m_Counts[m_Roots.back()];
		}
	}
	std::size_t Largest() const { return std::size_t(std::ranges::max_element(m_Counts) - m_Counts.begin()); }
	std::vector<std::size_t> m_Roots;
	std::vector<std::size_t> m_Counts;
};

/// A name that a file can hold and that none before it has.
std::string OwnName(const std::string& i_rJoint, std::set<std::string>& io_rNames)
{
	std::string name = i_rJoint.substr(i_rJoint.rfind(':') + 1);
	for (char& rByte : name)
		if (static_cast<unsigned char>(rByte) < ' ' || rByte == '\x7f')
			rByte = '_';
	if (name.empty())
		name = "Joint";
	std::string own = name;
	for (int i = 2; !io_rNames.insert(own).second; ++i)
		own = name + "_" + std::to_string(i);
	return own;
}

CoreOrlexTypes::VColour ColourOf(const std::string& i_rName)
{
	const SetupProposal::ESide side = SetupProposal::SideOfName(i_rName);
	return side == SetupProposal::ESide::Left ? c_LeftColour
	    : side == SetupProposal::ESide::Right ? c_RightColour
	                                          : CoreOrlexTypes::VColour();
}

void SetExpressions(const VVector3& i_rValues, std::array<std::string, 3>& o_rTexts)
{
	for (std::size_t i = 0; i < 3; ++i)
		o_rTexts[i] = NumberText::PrintG17(i_rValues[i]);
}

/// @param i_rPose the joint's in the bind pose, to its parent.
void AddSegment(const VJoint& i_rJoint, const VWorldPose& i_rPose, std::uint32_t i_Parent, const std::string& i_rName,
    const std::string& i_rJointName, CoreOrlexTypes::VSubjectRecord& io_rRecord)
{
	VSubjectParametrised& rSubject = io_rRecord.m_SubjectParametrised;
	VSubjectParametrised::VSegment segment;
	segment.m_Name = i_rName;
	segment.m_SegmentIndex = std::uint32_t(rSubject.m_Segments.size());
	segment.m_ParentSegmentIndex = i_Parent;
	const bool bRoot = i_Parent == CoreOrlexTypes::c_NoParent;
	segment.m_TreeDepth = bRoot ? 0 : rSubject.m_Segments[i_Parent].m_TreeDepth + 1;

	VSubjectJoint& rJoint = segment.m_Joint;
	rJoint.m_Name = i_rJointName;
	const bool bFixed = !bRoot && i_rJoint.m_Channels.empty() && !(Length(i_rJoint.m_Rest.t) > c_NoLength);
	rJoint.m_JointType = bRoot ? VSubjectJoint::EFree : bFixed ? VSubjectJoint::EDummy : VSubjectJoint::EBall;
	if (bRoot)
	{
		const VVector3 turn = Rotation::AngleAxisFromRotationMatrix(i_rPose.R);
		rJoint.m_BindPose.assign(turn.begin(), turn.end());
		rJoint.m_BindPose.insert(rJoint.m_BindPose.end(), i_rPose.t.begin(), i_rPose.t.end());
	}
	else
	{
		SetExpressions(Rotation::AngleAxisFromRotationMatrix(i_rJoint.m_Rest.R), segment.m_PreRotation);
		SetExpressions(i_rJoint.m_Rest.t, segment.m_PreTranslation);
		rJoint.m_BindPose.assign(CoreOrlexTypes::StateSize(rJoint.m_JointType), 0.0);
		// Equal ones leave nothing that rounding made.
		if (!bFixed && i_rPose.R != i_rJoint.m_Rest.R)
			std::ranges::copy(Rotation::AngleAxisFromRotationMatrix(
			                      Rotation::Product(Rotation::Transposed(i_rJoint.m_Rest.R), i_rPose.R)),
			    rJoint.m_BindPose.begin());
	}
	rJoint.m_Mean = rJoint.m_BindPose;
	rJoint.m_Covariance = CoreOrlexTypes::DefaultCovariance(rJoint.m_JointType);
	rSubject.m_Segments.push_back(std::move(segment));

	VSubjectApplicationData::VSegment look;
	look.m_Colour = ColourOf(i_rName);
	look.m_DrawStyle = VSubjectApplicationData::VSegment::EDrawStyleTetraStripe;
	if (!bFixed)
		look.m_Joint.m_EulerOrder = VSubjectApplicationData::VJoint::EXYZ;
	io_rRecord.m_SubjectApplicationData.m_Segments.push_back(look);
}

/// @return the marker's index.
std::uint32_t AddMarker(const std::string& i_rName, std::uint32_t i_Segment, const VVector3& i_rPlace,
    CoreOrlexTypes::VSubjectRecord& io_rRecord)
{
	VSubjectParametrised& rSubject = io_rRecord.m_SubjectParametrised;
	const auto index = std::uint32_t(rSubject.m_Markers.size());
	const CoreOrlexTypes::VColour colour = ColourOf(i_rName);
	VSubjectParametrised::VMarker marker;
	marker.m_Name = i_rName;
	marker.m_MarkerId = index;
	rSubject.m_Markers.push_back(std::move(marker));
	io_rRecord.m_SubjectApplicationData.m_Markers.push_back({colour});

	VSubjectParametrised::VTarget target;
	target.m_Type = VSubjectParametrised::VTarget::ELocalPointToWorldPoint;
	target.m_MarkerIndices = {index};
	target.m_SegmentIndices = {i_Segment};
	target.m_ViewNormals.resize(1);
	std::array<std::string, 3> place;
	SetExpressions(i_rPlace, place);
	target.m_StateExpressions.assign(place.begin(), place.end());
	rSubject.m_Targets.push_back(std::move(target));
	VSubjectApplicationData::VTarget look;
	look.m_Name = i_rName;
	look.m_Colour = colour;
	io_rRecord.m_SubjectApplicationData.m_Targets.push_back(std::move(look));
	return index;
}

/// Of the lowest joint or end of a bone below a root.
double LowestPoint(
    const VTake& i_rTake, const std::vector<VWorldPose>& i_rLocal, const VTrees& i_rTrees, std::size_t i_Root)
{
	std::vector<VWorldPose> poses;
	double lowest = i_rLocal[i_Root].t[2];
	for (std::size_t i = 0; i < i_rLocal.size(); ++i)
	{
		const std::int32_t parent = i_rTake.m_Joints[i].m_Parent;
		poses.push_back(parent < 0 ? i_rLocal[i] : Rotation::Compose(poses[std::size_t(parent)], i_rLocal[i]));
		if (i_rTrees.m_Roots[i] == i_Root)
		{
			lowest = std::min(lowest, poses[i].t[2]);
			for (const VVector3& rEnd : i_rTake.m_Joints[i].m_Ends)
				lowest = std::min(lowest, Rotation::Apply(poses[i], rEnd)[2]);
		}
	}
	return lowest;
}

} // namespace

CoreOrlexTypes::VSubjectRecord MakePerformer(
    const VTake& i_rTake, const VStandingPose& i_rPose, const std::string& i_rName, std::vector<VFinding>& o_rFindings)
{
	CoreOrlexTypes::VSubjectRecord record;
	VSubjectParametrised& rSubject = record.m_SubjectParametrised;
	rSubject.m_Name = i_rName;
	if (i_rTake.m_Joints.empty())
		return record;
	const VTrees trees(i_rTake);
	const std::size_t root = trees.Largest();
	const double raise = std::max(0.0, -LowestPoint(i_rTake, i_rPose.m_Poses, trees, root));

	// A file wants all of them to differ; segments come first, since targets and takes find them by name.
	std::set<std::string> taken;
	std::vector<std::string> names;
	for (std::size_t i = 0; i < i_rTake.m_Joints.size(); ++i)
		names.push_back(trees.m_Roots[i] == root ? OwnName(i_rTake.m_Joints[i].m_Name, taken) : std::string());
	std::vector<std::uint32_t> segments(i_rTake.m_Joints.size(), CoreOrlexTypes::c_NoParent);
	std::vector<std::uint32_t> markerOf(i_rTake.m_Joints.size(), 0);
	std::string others;
	for (std::size_t i = 0; i < i_rTake.m_Joints.size(); ++i)
	{
		const VJoint& rJoint = i_rTake.m_Joints[i];
		if (trees.m_Roots[i] != root)
		{
			if (rJoint.m_Parent < 0)
				others += (others.empty() ? "" : ", ") + rJoint.m_Name;
			continue;
		}
		const std::string& rName = names[i];
		segments[i] = std::uint32_t(rSubject.m_Segments.size());
		VWorldPose pose = i_rPose.m_Poses[i];
		if (i == root)
			pose.t[2] += raise;
		const bool bBone = i != root && Length(rJoint.m_Rest.t) > c_NoLength;
		AddSegment(rJoint, pose, i == root ? CoreOrlexTypes::c_NoParent : segments[std::size_t(rJoint.m_Parent)], rName,
		    OwnName(rName + "Joint", taken), record);
		auto& rSticks = record.m_SubjectApplicationData.m_Sticks;
		const auto addStick = [&](std::uint32_t i_From, std::uint32_t i_To)
		{
			const CoreOrlexTypes::VColour colour = ColourOf(rName);
			rSticks.push_back({i_From, colour, i_To, colour});
		};
		// A joint that stands where its parent does shares the parent's marker.
		markerOf[i] = i == root || bBone ? AddMarker(OwnName(rName + "Marker", taken), segments[i], {}, record)
		                                 : markerOf[std::size_t(rJoint.m_Parent)];
		if (bBone)
			addStick(markerOf[std::size_t(rJoint.m_Parent)], markerOf[i]);
		for (const VVector3& rEnd : rJoint.m_Ends)
			if (Length(rEnd) > c_NoLength)
				addStick(markerOf[i], AddMarker(OwnName(rName + "End", taken), segments[i], rEnd, record));
	}
	if (!others.empty())
		o_rFindings.push_back({"trees",
		    "The take holds several skeletons. The performer is made of the largest, which begins at "
		        + i_rTake.m_Joints[root].m_Name + "; left out is what begins at " + others + "."});
	return record;
}

} // namespace TakeSolve
