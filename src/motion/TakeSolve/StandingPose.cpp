#include "TakeSolve/StandingPose.h"

#include "TakeSolve/Stands.h"
#include "TakeSolve/Vectors.h"

#include "SetupProposal/BodyParts.h"

#include <numeric>
#include <optional>

namespace TakeSolve
{
namespace
{

using namespace SetupProposal;
using TakeIO::VTake;

constexpr std::int64_t c_None = -1;

double Median(std::vector<double> i_Values)
{
	const auto middle = i_Values.begin() + std::ptrdiff_t(i_Values.size() / 2);
	std::ranges::nth_element(i_Values, middle);
	return *middle;
}

/// A foot with its toe, followed through the frames.
struct VFollowed
{
	VStandingFoot m_Foot;
	std::int64_t m_Toe = c_None;
	/// By frames: the places, and what points up in the frames of the joints.
	std::vector<VVector3> m_Places[2];
	std::vector<VVector3> m_Ups[2];

	std::int64_t Joint(std::size_t i_Part) const { return i_Part == 0 ? std::int64_t(m_Foot.m_Joint) : m_Toe; }
};

std::vector<VFollowed> FindFeet(const VTake& i_rTake)
{
	std::vector<VWorldPose> poses;
	TakeIO::WorldRestPoses(i_rTake, poses);
	VRestSkeleton skeleton;
	for (std::size_t i = 0; i < poses.size(); ++i)
	{
		const TakeIO::VJoint& rJoint = i_rTake.m_Joints[i];
		skeleton.push_back({rJoint.m_Name.substr(rJoint.m_Name.rfind(':') + 1), rJoint.m_Parent, poses[i].t, true});
	}
	const VBodyReading body = ReadBody(skeleton);
	const auto find = [&](EBodyPart i_Part, ESide i_Side)
	{
		const auto found = std::ranges::find_if(body.m_Joints,
		    [&](const VJointReading& i_rJoint) { return i_rJoint.m_Part == i_Part && i_rJoint.m_Side == i_Side; });
		return found == body.m_Joints.end() ? c_None : std::int64_t(found - body.m_Joints.begin());
	};
	std::vector<VFollowed> feet;
	for (const ESide side : {ESide::Left, ESide::Right})
	{
		const std::int64_t foot = find(EFoot, side);
		if (foot == c_None)
			continue;
		VFollowed followed;
		followed.m_Foot.m_Joint = std::size_t(foot);
		followed.m_Foot.m_Side = side;
		if (const std::int64_t toe = find(EToe, side); toe > foot)
			followed.m_Toe = toe;
		feet.push_back(std::move(followed));
	}
	return feet;
}

/// The frames in which foot and toe stand, by index.
std::vector<std::size_t> StandingFrames(const VFollowed& i_rFoot, double i_Rate)
{
	std::vector<std::uint8_t> standing(i_rFoot.m_Places[0].size(), 0);
	const std::size_t parts = i_rFoot.m_Toe == c_None ? 1 : 2;
	for (std::size_t part = 0; part < parts; ++part)
		for (const VStand& rStand : FindStands(i_rFoot.m_Places[part], i_Rate))
			for (std::size_t frame = rStand.m_First; frame < rStand.m_Last; ++frame)
				++standing[frame];
	std::vector<std::size_t> frames;
	for (std::size_t i = 0; i < standing.size(); ++i)
		if (standing[i] == parts)
			frames.push_back(i);
	return frames;
}

template <typename TValue>
double MedianOver(const std::vector<std::size_t>& i_rFrames, TValue i_Value)
{
	std::vector<double> values;
	values.reserve(i_rFrames.size());
	for (const std::size_t frame : i_rFrames)
		values.push_back(i_Value(frame));
	return Median(std::move(values));
}

} // namespace

VStandingPose RestPose(const VTake& i_rTake)
{
	VStandingPose pose;
	for (const TakeIO::VJoint& rJoint : i_rTake.m_Joints)
		pose.m_Poses.push_back(rJoint.m_Rest);
	return pose;
}

VStandingPose StandingPose(const VTake& i_rTake)
{
	VStandingPose pose = RestPose(i_rTake);
	std::vector<VFollowed> feet = FindFeet(i_rTake);
	if (feet.empty())
		return pose;
	std::vector<VWorldPose> world;
	for (std::size_t frame = 0; frame < i_rTake.m_Frames; ++frame)
	{
		TakeIO::WorldPoses(i_rTake, frame, world);
		for (VFollowed& rFoot : feet)
			for (std::size_t part = 0; part < 2; ++part)
				if (const std::int64_t joint = rFoot.Joint(part); joint != c_None)
				{
					const VWorldPose& rPose = world[std::size_t(joint)];
					rFoot.m_Places[part].push_back(rPose.t);
					rFoot.m_Ups[part].push_back({rPose.R[6], rPose.R[7], rPose.R[8]});
				}
	}

	TakeIO::WorldRestPoses(i_rTake, world);
	std::vector<double> lifts;
	std::vector<std::optional<VVector3>> ups(world.size());
	for (VFollowed& rFoot : feet)
	{
		const std::vector<std::size_t> frames = StandingFrames(rFoot, i_rTake.m_Rate);
		rFoot.m_Foot.m_Frames = frames.size();
		if (frames.empty())
			continue;
		rFoot.m_Foot.m_Height = MedianOver(frames, [&](std::size_t i_Frame) { return rFoot.m_Places[0][i_Frame][2]; });
		lifts.push_back(rFoot.m_Foot.m_Height - world[rFoot.m_Foot.m_Joint].t[2]);
		for (std::size_t part = 0; part < 2; ++part)
			if (const std::int64_t joint = rFoot.Joint(part); joint != c_None)
			{
				VVector3& rUp = ups[std::size_t(joint)].emplace();
				for (std::size_t axis = 0; axis < 3; ++axis)
					rUp[axis] =
					    MedianOver(frames, [&](std::size_t i_Frame) { return rFoot.m_Ups[part][i_Frame][axis]; });
			}
	}

	const double lift = lifts.empty() ? 0.0 : std::accumulate(lifts.begin(), lifts.end(), 0.0) / double(lifts.size());
	for (std::size_t i = 0; i < world.size(); ++i)
	{
		VWorldPose& rLocal = pose.m_Poses[i];
		const std::int32_t parent = i_rTake.m_Joints[i].m_Parent;
		if (parent < 0)
			rLocal.t[2] += lift;
		world[i] = parent < 0 ? rLocal : Rotation::Compose(world[std::size_t(parent)], rLocal);
		if (!ups[i])
			continue;
		const VMatrix3 turn = ShortestArc(Rotation::Product(world[i].R, *ups[i]), {0.0, 0.0, 1.0});
		world[i].R = Rotation::Product(turn, world[i].R);
		rLocal = parent < 0 ? world[i] : Rotation::Relative(world[std::size_t(parent)], world[i]);
		for (VFollowed& rFoot : feet)
			if (rFoot.m_Foot.m_Joint == i)
				rFoot.m_Foot.m_Turn = AngleBetween(turn, Rotation::c_Identity3);
	}
	for (const VFollowed& rFoot : feet)
		pose.m_Feet.push_back(rFoot.m_Foot);
	return pose;
}

std::string TextOf(const VStandingPose& i_rPose, const VTake& i_rTake)
{
	std::string turned;
	std::string never;
	for (const VStandingFoot& rFoot : i_rPose.m_Feet)
	{
		const std::string& rName = i_rTake.m_Joints[rFoot.m_Joint].m_Name;
		if (rFoot.m_Frames == 0)
			never += (never.empty() ? "" : " and ") + rName;
		else
			turned += (turned.empty() ? "" : ", ") + rName + " is turned by "
			    + std::to_string(std::lround(c_Degrees * rFoot.m_Turn)) + " degrees and "
			    + std::to_string(std::lround(rFoot.m_Height)) + " mm up";
	}
	std::string text;
	if (!turned.empty())
		text = "In the bind pose the feet stand as in the take, not as in its rest pose: " + turned + ".";
	if (!never.empty())
		text += (text.empty() ? "" : " ") + never
		    + (turned.empty() ? " never stand in the take, and stay as in its rest pose."
		                      : " never stands in it, and stays.");
	return text;
}

} // namespace TakeSolve
