#pragma once

#include "numerics/Rotation.h"

#include <cstddef>
#include <cstdint>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace TakeIO
{

using VJointPose = Rotation::VPose<double>;

/// What one number of a frame is: a coordinate of a joint's place, or an angle about one of its axes. The kind is the
/// number divided by 3, the axis the rest.
enum class EChannel : std::uint8_t
{
	XPosition,
	YPosition,
	ZPosition,
	XRotation,
	YRotation,
	ZRotation
};

/// As BVH files spell them; by channel.
inline constexpr std::string_view c_ChannelNames[]{
    "Xposition", "Yposition", "Zposition", "Xrotation", "Yrotation", "Zrotation"};

constexpr int AxisOf(EChannel i_Channel)
{
	return int(i_Channel) % 3;
}

constexpr bool IsRotation(EChannel i_Channel)
{
	return i_Channel >= EChannel::XRotation;
}

struct VJoint
{
	/// UTF-8 as a rule; of a file that is something else its bytes.
	std::string m_Name;
	/// It stands before this one; -1 of a root.
	std::int32_t m_Parent = -1;
	/// To the parent, of a root to the world.
	VJointPose m_Rest;
	/// In the order in which the rotations are multiplied: the first is the outermost.
	std::vector<EChannel> m_Channels;
	/// Of the first channel in a frame's values; the others follow it.
	std::size_t m_FirstValue = 0;
	/// Points without a joint of their own at which bones end, in this joint's frame.
	std::vector<Rotation::VVector3> m_Ends;
};

/// Which axis of a file points up. Both kinds are right-handed.
enum class EUp
{
	Y,
	Z
};

/// Recorded motion of one skeleton. Millimetres and radians; world and joint frames are right-handed with Z up, so that
/// what a file with Y up calls (x, y, z) is (x, -z, y) here, in the frames of joints too: their rest rotations stay
/// what they are in the file. In a frame, a coordinate or the rotation that no channel gives is that of the rest pose.
struct VTake
{
	/// Parents before children.
	std::vector<VJoint> m_Joints;
	/// Frames a second.
	double m_Rate = 0.0;
	std::size_t m_Frames = 0;
	/// Of a frame.
	std::size_t m_Channels = 0;
	/// Frame after frame.
	std::vector<double> m_Values;

	/// What the file had: only for those who tell, or write the like.
	EUp m_FileUp = EUp::Y;
	double m_FileUnit = 1.0;

	const double* Frame(std::size_t i_Frame) const { return m_Values.data() + i_Frame * m_Channels; }
};

/// From the joint to its parent; of a root to the world.
VJointPose LocalPose(const VTake& i_rTake, std::size_t i_Joint, std::size_t i_Frame);

/// Of all joints, into room that is kept from call to call.
void WorldPoses(const VTake& i_rTake, std::size_t i_Frame, std::vector<VJointPose>& o_rPoses);
void WorldRestPoses(const VTake& i_rTake, std::vector<VJointPose>& o_rPoses);

/// A joint that may go and turn anywhere; the last three are those of one that only turns.
inline constexpr EChannel c_AllChannels[]{EChannel::XPosition, EChannel::YPosition, EChannel::ZPosition,
    EChannel::ZRotation, EChannel::YRotation, EChannel::XRotation};

/// Gives a joint c_AllChannels, or the last three. Joints in their order, before the first frame.
void AddChannels(VTake& io_rTake, std::size_t i_Joint, bool i_bGoes);

/// Rest poses, and another frame, from the poses of all joints in the world. Joints have the channels that AddChannels
/// gives, or none: these keep their rest pose.
void SetWorldRest(VTake& io_rTake, std::span<const VJointPose> i_Poses);
void AddFrame(VTake& io_rTake, std::span<const VJointPose> i_Poses);

/// The same motion at another rate, from the first frame on to the last that is not beyond the end. Between two frames
/// places go along a line and rotations about one axis, by the shorter way.
/// @return false, with nothing changed, if that were more than c_Values.
bool Resample(VTake& io_rTake, double i_Rate);

} // namespace TakeIO
