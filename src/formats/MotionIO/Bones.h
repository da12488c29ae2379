#pragma once

#include "MotionIO/PrintMotion.h"
#include "TakeIO/FbxJoints.h"

namespace MotionIO
{

/// Millimetres, nearer than which a joint keeps its place.
inline constexpr double c_SamePlace = 1e-4;

/// The bones of a character, with all above them.
struct VBones
{
	/// False, with the reason, if the file is no character.
	bool Read(const VCharacterFile& i_rFile, std::string& o_rError);

	const FbxFormat::VObject& Object(std::size_t i_Bone) const
	{
		return m_Records.Document().Objects()[m_Joints[i_Bone].m_Object];
	}

	TakeIO::VFbxRecords m_Records;
	TakeIO::EUp m_Up = TakeIO::EUp::Y;
	/// Millimetres.
	double m_Unit = 0.0;
	std::vector<TakeIO::VFbxJoint> m_Joints;
	std::vector<std::string> m_Names;
};

/// Turns what has that axis up into Z up.
Rotation::VMatrix3 ToZUp(TakeIO::EUp i_Up);

/// What the bones do in the frames of a motion, in the file's own terms: its axes, unit, pivots, rotation orders and
/// pre- and post-rotations. What single precision loses at a bone is made up for by those below it.
class VBoneMotion
{
public:
	VBoneMotion(const VBones& i_rBones, const TakeIO::VTake& i_rMotion, double i_Scale);

	/// How many bones have a joint.
	std::size_t Driven() const { return m_Driven; }
	bool IsDriven(std::size_t i_Bone) const { return m_JointOf[i_Bone] >= 0; }

	/// Frames one after the other: angles go on from where they were. Without a frame as the file has them.
	void Compute(std::optional<std::size_t> i_Frame);

	/// As Lcl Translation and Lcl Rotation are to be.
	const FbxFormat::VNodeTransform& Transform(std::size_t i_Bone) const { return m_Transforms[i_Bone]; }
	/// In the file's axes and unit.
	const FbxFormat::VGlobalTransform& Global(std::size_t i_Bone) const { return m_Globals[i_Bone]; }

private:
	void FindJoints();
	void Drive(std::size_t i_Bone, const TakeIO::VJointPose& i_rJoint, const FbxFormat::VGlobalTransform& i_rParent);

	const VBones& m_rBones;
	const TakeIO::VTake& m_rMotion;
	/// A joint's frame as a bone's, and the world of the motion as that of the file.
	Rotation::VMatrix3 m_ToBone;
	Rotation::VMatrix3 m_ToFile;
	double m_Factor;
	/// -1 without one.
	std::vector<std::int32_t> m_JointOf;
	std::size_t m_Driven = 0;
	std::vector<TakeIO::VJointPose> m_Poses;
	std::vector<FbxFormat::VNodeTransform> m_Transforms;
	std::vector<FbxFormat::VGlobalTransform> m_Globals;
};

} // namespace MotionIO
