#include "TakeIO/Take.h"

#include "TakeIO/Limits.h"

#include <algorithm>
#include <cmath>

using namespace Rotation;

namespace
{

using namespace TakeIO;

/// R times the rotation about one of the axes.
void Turn(VMatrix3& io_rMatrix, int i_Axis, double i_Angle)
{
	const double c = std::cos(i_Angle);
	const double s = std::sin(i_Angle);
	const int first = (i_Axis + 1) % 3;
	const int second = (i_Axis + 2) % 3;
	for (int row = 0; row < 9; row += 3)
	{
		const double a = io_rMatrix[row + first];
		const double b = io_rMatrix[row + second];
		io_rMatrix[row + first] = c * a + s * b;
		io_rMatrix[row + second] = c * b - s * a;
	}
}

/// i_Local(joint) is the pose to the parent.
template <typename TLocal>
void ComposeAll(const VTake& i_rTake, std::vector<VJointPose>& o_rPoses, const TLocal& i_Local)
{
	o_rPoses.resize(i_rTake.m_Joints.size());
	for (std::size_t i = 0; i < o_rPoses.size(); ++i)
	{
		const std::int32_t parent = i_rTake.m_Joints[i].m_Parent;
		o_rPoses[i] = parent < 0 ? i_Local(i) : Compose(o_rPoses[parent], i_Local(i));
	}
}

/// Of a joint to its parent, from poses in the world.
VJointPose LocalOf(const VTake& i_rTake, std::size_t i_Joint, std::span<const VJointPose> i_Poses)
{
	const std::int32_t parent = i_rTake.m_Joints[i_Joint].m_Parent;
	return parent < 0 ? i_Poses[i_Joint] : Relative(i_Poses[std::size_t(parent)], i_Poses[i_Joint]);
}

/// A frame's own pose at part 0, the next one's at 1.
VJointPose Between(const VJointPose& i_rFrom, const VJointPose& i_rTo, double i_Part)
{
	VJointPose pose;
	VVector3 turn = AngleAxisFromRotationMatrix(Product(Transposed(i_rFrom.R), i_rTo.R));
	for (int i = 0; i < 3; ++i)
	{
		turn[i] *= i_Part;
		pose.t[i] = i_rFrom.t[i] + i_Part * (i_rTo.t[i] - i_rFrom.t[i]);
	}
	pose.R = Product(i_rFrom.R, RotationMatrixFromAngleAxis(turn));
	return pose;
}

/// Three angles for each joint that turns: single ones between two frames are not those of the rotation between them.
void UseThreeAngles(VTake& io_rTake)
{
	io_rTake.m_Channels = 0;
	for (VJoint& rJoint : io_rTake.m_Joints)
	{
		std::vector<EChannel> channels;
		std::ranges::copy_if(
		    rJoint.m_Channels, std::back_inserter(channels), [](EChannel i_Channel) { return !IsRotation(i_Channel); });
		if (channels.size() < rJoint.m_Channels.size())
			channels.insert(channels.end(), {EChannel::ZRotation, EChannel::YRotation, EChannel::XRotation});
		rJoint.m_Channels = std::move(channels);
		rJoint.m_FirstValue = io_rTake.m_Channels;
		io_rTake.m_Channels += rJoint.m_Channels.size();
	}
}

} // namespace

VJointPose TakeIO::LocalPose(const VTake& i_rTake, std::size_t i_Joint, std::size_t i_Frame)
{
	const VJoint& rJoint = i_rTake.m_Joints[i_Joint];
	VJointPose pose = rJoint.m_Rest;
	const double* pValue = i_rTake.Frame(i_Frame) + rJoint.m_FirstValue;
	bool bTurned = false;
	for (const EChannel channel : rJoint.m_Channels)
	{
		const double value = *pValue++;
		if (!IsRotation(channel))
		{
			pose.t[AxisOf(channel)] = value;
			continue;
		}
		if (!bTurned)
			pose.R = c_Identity3;
		bTurned = true;
		Turn(pose.R, AxisOf(channel), value);
	}
	return pose;
}

void TakeIO::WorldPoses(const VTake& i_rTake, std::size_t i_Frame, std::vector<VJointPose>& o_rPoses)
{
	ComposeAll(i_rTake, o_rPoses, [&](std::size_t i_Joint) { return LocalPose(i_rTake, i_Joint, i_Frame); });
}

void TakeIO::WorldRestPoses(const VTake& i_rTake, std::vector<VJointPose>& o_rPoses)
{
	ComposeAll(i_rTake, o_rPoses, [&](std::size_t i_Joint) { return i_rTake.m_Joints[i_Joint].m_Rest; });
}

void TakeIO::AddChannels(VTake& io_rTake, std::size_t i_Joint, bool i_bGoes)
{
	VJoint& rJoint = io_rTake.m_Joints[i_Joint];
	rJoint.m_Channels.assign(std::begin(c_AllChannels) + (i_bGoes ? 0 : 3), std::end(c_AllChannels));
	rJoint.m_FirstValue = io_rTake.m_Channels;
	io_rTake.m_Channels += rJoint.m_Channels.size();
}

void TakeIO::SetWorldRest(VTake& io_rTake, std::span<const VJointPose> i_Poses)
{
	for (std::size_t i = 0; i < io_rTake.m_Joints.size(); ++i)
		io_rTake.m_Joints[i].m_Rest = LocalOf(io_rTake, i, i_Poses);
}

void TakeIO::AddFrame(VTake& io_rTake, std::span<const VJointPose> i_Poses)
{
	for (std::size_t i = 0; i < io_rTake.m_Joints.size(); ++i)
	{
		if (io_rTake.m_Joints[i].m_Channels.empty())
			continue;
		const VJointPose pose = LocalOf(io_rTake, i, i_Poses);
		VVector3 angles{};
		EulerFromRotationMatrix(pose.R, EZYX, angles);
		if (!IsRotation(io_rTake.m_Joints[i].m_Channels.front()))
			io_rTake.m_Values.insert(io_rTake.m_Values.end(), pose.t.begin(), pose.t.end());
		io_rTake.m_Values.insert(io_rTake.m_Values.end(), angles.begin(), angles.end());
	}
	++io_rTake.m_Frames;
}

bool TakeIO::Resample(VTake& io_rTake, double i_Rate)
{
	if (io_rTake.m_Frames == 0 || i_Rate == io_rTake.m_Rate)
		return true;
	VTake take = io_rTake;
	take.m_Rate = i_Rate;
	UseThreeAngles(take);
	const double step = io_rTake.m_Rate / i_Rate;
	const std::size_t lastFrame = io_rTake.m_Frames - 1;
	// A last frame that rounding puts behind the end is there all the same.
	const double frames = std::floor(double(lastFrame) / step + 1e-6) + 1.0;
	if (frames * double(std::max<std::size_t>(take.m_Channels, 1)) > double(Limits::c_Values))
		return false;
	take.m_Frames = std::size_t(frames);
	take.m_Values.clear();
	take.m_Values.reserve(take.m_Frames * take.m_Channels);
	for (std::size_t frame = 0; frame < take.m_Frames; ++frame)
	{
		const double at = std::min(double(frame) * step, double(lastFrame));
		const auto before = std::size_t(at);
		const std::size_t after = std::min(before + 1, lastFrame);
		for (std::size_t joint = 0; joint < take.m_Joints.size(); ++joint)
		{
			const std::vector<EChannel>& rChannels = take.m_Joints[joint].m_Channels;
			if (rChannels.empty())
				continue;
			const VJointPose pose =
			    Between(LocalPose(io_rTake, joint, before), LocalPose(io_rTake, joint, after), at - double(before));
			VVector3 angles{};
			EulerFromRotationMatrix(pose.R, EZYX, angles);
			std::size_t angle = 0;
			for (const EChannel channel : rChannels)
				take.m_Values.push_back(IsRotation(channel) ? angles[angle++] : pose.t[AxisOf(channel)]);
		}
	}
	io_rTake = std::move(take);
	return true;
}
