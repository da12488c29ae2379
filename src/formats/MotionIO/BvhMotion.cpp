#include "MotionIO/BvhMotion.h"

#include "TakeIO/BvhWriter.h"

#include <algorithm>
#include <cmath>

using TakeIO::VJoint;
using TakeIO::VJointPose;
using TakeIO::VTake;

namespace
{

using namespace MotionIO;

/// Whether a joint ever stands elsewhere on its parent than at rest.
bool Goes(const VTake& i_rMotion, std::size_t i_Joint)
{
	const VJoint& rJoint = i_rMotion.m_Joints[i_Joint];
	if (rJoint.m_Parent < 0)
		return true;
	for (std::size_t i = 0; i < rJoint.m_Channels.size(); ++i)
		for (std::size_t frame = 0; frame < i_rMotion.m_Frames && !IsRotation(rJoint.m_Channels[i]); ++frame)
			if (std::abs(i_rMotion.Frame(frame)[rJoint.m_FirstValue + i]
			        - rJoint.m_Rest.t[std::size_t(AxisOf(rJoint.m_Channels[i]))])
			    > c_SamePlace)
				return true;
	return false;
}

/// The same skeleton with joints that stand unturned at rest, and without a frame.
VTake Unturned(const VTake& i_rMotion, double i_Scale, std::vector<VJointPose>& io_rRest)
{
	VTake take;
	take.m_Rate = i_rMotion.m_Rate;
	take.m_FileUp = i_rMotion.m_FileUp;
	take.m_FileUnit = i_rMotion.m_FileUnit;
	WorldRestPoses(i_rMotion, io_rRest);
	std::vector<VJointPose> unturned;
	for (std::size_t i = 0; i < i_rMotion.m_Joints.size(); ++i)
	{
		const VJoint& rFrom = i_rMotion.m_Joints[i];
		VJoint& rJoint = take.m_Joints.emplace_back();
		// Most programs end a name at a blank.
		rJoint.m_Name = rFrom.m_Name;
		std::ranges::replace(rJoint.m_Name, ' ', '_');
		rJoint.m_Parent = rFrom.m_Parent;
		for (Rotation::VVector3 end : rFrom.m_Ends)
		{
			end = Rotation::Product(io_rRest[i].R, end);
			for (double& rCoordinate : end)
				rCoordinate /= i_Scale;
			rJoint.m_Ends.push_back(end);
		}
		AddChannels(take, i, Goes(i_rMotion, i));
		VJointPose& rPose = unturned.emplace_back();
		for (std::size_t axis = 0; axis < 3; ++axis)
			rPose.t[axis] = io_rRest[i].t[axis] / i_Scale;
	}
	SetWorldRest(take, unturned);
	return take;
}

} // namespace

MotionIO::EPrinted MotionIO::PrintBvhMotion(
    const VBones* i_pBones, const VTake& i_rMotion, const VMotionSettings& i_rSettings, std::string& o_rBytes)
{
	std::vector<VJointPose> rest, poses;
	VTake take = Unturned(i_rMotion, i_rSettings.m_Scale, rest);
	if (i_pBones)
	{
		take.m_FileUp = i_pBones->m_Up;
		take.m_FileUnit = i_pBones->m_Unit;
	}
	take.m_Values.reserve(i_rMotion.m_Frames * take.m_Channels);
	for (std::size_t frame = 0; frame < i_rMotion.m_Frames; ++frame)
	{
		if (i_rSettings.m_Progress && !i_rSettings.m_Progress(double(frame) / double(i_rMotion.m_Frames)))
			return EPrinted::Cancelled;
		WorldPoses(i_rMotion, frame, poses);
		for (std::size_t i = 0; i < poses.size(); ++i)
		{
			poses[i].R = Rotation::Product(poses[i].R, Rotation::Transposed(rest[i].R));
			for (double& rCoordinate : poses[i].t)
				rCoordinate /= i_rSettings.m_Scale;
		}
		AddFrame(take, poses);
	}
	o_rBytes = PrintBvh(take);
	return EPrinted::Done;
}
