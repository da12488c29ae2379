#include "MotionIO/Bones.h"

#include "DebugServices/GlobalLog.h"
#include "TakeIO/Axes.h"

#include <algorithm>
#include <cmath>
#include <map>
#include <numbers>

using namespace Rotation;

namespace
{

using namespace MotionIO;
using FbxFormat::ERotationOrder;

/// The order of ours whose angles, last to first, turn about fixed axes as that of the format.
constexpr EEulerOrder c_Orders[]{EZYX, EYZX, EXZY, EZXY, EYXZ, EXYZ};
/// Where each of these angles stands as the format has them, x, y and z.
constexpr int c_Places[][3]{{2, 1, 0}, {1, 2, 0}, {0, 2, 1}, {2, 0, 1}, {1, 0, 2}, {0, 1, 2}};

double Distance(const VVector3& i_rA, const VVector3& i_rB)
{
	return std::abs(i_rA[0] - i_rB[0]) + std::abs(i_rA[1] - i_rB[1]) + std::abs(i_rA[2] - i_rB[2]);
}

VVector3 WholeTurnsTo(VVector3 i_Angles, const VVector3& i_rNear)
{
	for (std::size_t i = 0; i < 3; ++i)
		i_Angles[i] += 360.0 * std::round((i_rNear[i] - i_Angles[i]) / 360.0);
	return i_Angles;
}

/// Degrees as the format has them; of all that give the rotation those next to where they were, so that nothing spins
/// between two frames.
VVector3 AnglesOf(const VMatrix3& i_rRotation, ERotationOrder i_Order, const VVector3& i_rNear)
{
	VVector3 sequence{};
	EulerFromRotationMatrix(i_rRotation, c_Orders[int(i_Order)], sequence);
	const int* const pPlaces = c_Places[int(i_Order)];
	VVector3 angles{}, other{};
	for (std::size_t i = 0; i < 3; ++i)
	{
		const double degrees = sequence[i] * 180.0 / std::numbers::pi;
		angles[std::size_t(pPlaces[i])] = degrees;
		other[std::size_t(pPlaces[i])] = i == 1 ? 180.0 - degrees : degrees + 180.0;
	}
	angles = WholeTurnsTo(angles, i_rNear);
	other = WholeTurnsTo(other, i_rNear);
	return Distance(other, i_rNear) < Distance(angles, i_rNear) ? other : angles;
}

VVector3 InSinglePrecision(const VVector3& i_rVector)
{
	return {double(float(i_rVector[0])), double(float(i_rVector[1])), double(float(i_rVector[2]))};
}

std::string_view WithoutNamespace(std::string_view i_Name)
{
	return i_Name.substr(i_Name.rfind(':') + 1);
}

} // namespace

bool MotionIO::VBones::Read(const VCharacterFile& i_rFile, std::string& o_rError)
{
	if (!m_Records.Read(i_rFile.m_Bytes, o_rError) || !TakeIO::ReadFbxJoints(m_Records.Document(), m_Joints, o_rError))
		return false;
	const TakeIO::VFbxSettings settings = TakeIO::ReadFbxSettings(m_Records.Document());
	if (!settings.m_Up || !(settings.m_Unit > 0.0))
	{
		o_rError = settings.m_Up ? "Its unit is none" : "Its X axis points up, which is not read";
		return false;
	}
	m_Up = *settings.m_Up;
	m_Unit = settings.m_Unit;
	for (std::size_t i = 0; i < m_Joints.size(); ++i)
		m_Names.push_back(m_Records.Document().Decoded(Object(i).m_Name));
	return true;
}

VMatrix3 MotionIO::ToZUp(TakeIO::EUp i_Up)
{
	VMatrix3 matrix{};
	for (int from = 0; from < 3; ++from)
	{
		const TakeIO::VAxis to = TakeIO::AxisFromFile(i_Up, from);
		matrix[3 * std::size_t(to.m_Axis) + std::size_t(from)] = to.m_Sign;
	}
	return matrix;
}

MotionIO::VBoneMotion::VBoneMotion(const VBones& i_rBones, const TakeIO::VTake& i_rMotion, double i_Scale)
    : m_rBones(i_rBones), m_rMotion(i_rMotion), m_ToBone(ToZUp(i_rMotion.m_FileUp)),
      m_ToFile(Transposed(ToZUp(i_rBones.m_Up))), m_Factor(1.0 / (i_rBones.m_Unit * i_Scale)),
      m_JointOf(i_rBones.m_Joints.size(), -1), m_Globals(i_rBones.m_Joints.size())
{
	for (const TakeIO::VFbxJoint& rJoint : i_rBones.m_Joints)
		m_Transforms.push_back(rJoint.m_Rest);
	FindJoints();
}

void MotionIO::VBoneMotion::FindJoints()
{
	// Those of one name in their order, last first.
	std::map<std::string_view, std::vector<std::size_t>> whole, bare;
	for (std::size_t bone = m_rBones.m_Names.size(); bone-- > 0;)
	{
		whole[m_rBones.m_Names[bone]].push_back(bone);
		bare[WithoutNamespace(m_rBones.m_Names[bone])].push_back(bone);
	}
	const auto take = [this](auto& io_rByName, std::string_view i_Name, std::size_t i_Joint)
	{
		const auto found = io_rByName.find(i_Name);
		for (; found != io_rByName.end() && !found->second.empty(); found->second.pop_back())
			if (std::int32_t& rJoint = m_JointOf[found->second.back()]; rJoint < 0)
			{
				rJoint = std::int32_t(i_Joint);
				return true;
			}
		return false;
	};
	const std::vector<TakeIO::VJoint>& rJoints = m_rMotion.m_Joints;
	std::vector<bool> found(rJoints.size());
	for (std::size_t i = 0; i < rJoints.size(); ++i)
		found[i] = take(whole, rJoints[i].m_Name, i);
	std::size_t missing = 0;
	std::string_view example;
	for (std::size_t i = 0; i < rJoints.size(); ++i)
		if (found[i] || take(bare, WithoutNamespace(rJoints[i].m_Name), i))
			++m_Driven;
		else if (++missing == 1)
			example = rJoints[i].m_Name;
	if (missing > 0 && m_Driven > 0)
		NVX_LOG("MotionIO", NVX::ELogWarning,
		    "Joints of the motion that are left out, as the character has no bone of that name: %1%, such as \"%2%\"",
		    missing, example);
}

void MotionIO::VBoneMotion::Compute(std::optional<std::size_t> i_Frame)
{
	if (i_Frame)
		TakeIO::WorldPoses(m_rMotion, *i_Frame, m_Poses);
	for (std::size_t i = 0; i < m_Transforms.size(); ++i)
	{
		const TakeIO::VFbxJoint& rBone = m_rBones.m_Joints[i];
		const FbxFormat::VGlobalTransform parent =
		    rBone.m_Parent < 0 ? FbxFormat::VGlobalTransform() : m_Globals[std::size_t(rBone.m_Parent)];
		if (i_Frame && IsDriven(i))
			Drive(i, m_Poses[std::size_t(m_JointOf[i])], parent);
		m_Globals[i] =
		    FbxFormat::GlobalTransform(parent, FbxFormat::LocalTransform(m_Transforms[i]), rBone.m_Rest.m_InheritType);
	}
}

void MotionIO::VBoneMotion::Drive(
    std::size_t i_Bone, const TakeIO::VJointPose& i_rJoint, const FbxFormat::VGlobalTransform& i_rParent)
{
	FbxFormat::VNodeTransform& rBone = m_Transforms[i_Bone];
	VMatrix3 rotation = Product(m_ToFile, Product(i_rJoint.R, m_ToBone));
	rotation = Product(Transposed(i_rParent.m_Rotation), rotation);
	if (rBone.HasRotationSpace())
		rotation = Product(Transposed(FbxFormat::EulerRotation(rBone.m_PreRotation, ERotationOrder::XYZ)),
		    Product(rotation, FbxFormat::EulerRotation(rBone.m_PostRotation, ERotationOrder::XYZ)));
	const ERotationOrder order = rBone.HasRotationSpace() ? rBone.m_Order : ERotationOrder::XYZ;
	rBone.m_Rotation = InSinglePrecision(AnglesOf(rotation, order, rBone.m_Rotation));

	// What the rest of the chain moves is taken off its place in the parent.
	const VVector3 world = Product(m_ToFile, i_rJoint.t);
	VVector3 place;
	for (std::size_t i = 0; i < 3; ++i)
		place[i] = m_Factor * world[i] - i_rParent.m_Map.t[i];
	place = Product(FbxFormat::Inverse({i_rParent.m_Map.L, {}}).L, place);
	rBone.m_Translation = {};
	const VVector3 chain = FbxFormat::LocalTransform(rBone).m_Map.t;
	for (std::size_t i = 0; i < 3; ++i)
		rBone.m_Translation[i] = place[i] - chain[i];
	rBone.m_Translation = InSinglePrecision(rBone.m_Translation);
}
