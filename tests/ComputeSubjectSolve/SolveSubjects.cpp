#include "SolveSubjects.h"

#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "CoreOrlexTypesUtils/convert/SubjectParametrisedConverter.h"
#include "CoreOrlexTypesUtils/joints/PoseVector.h"
#include "FBXIO/FBXReader.h"
#include "RetargetSetupCore/GlobalScale.h"
#include "RetargetSetupCore/TargetConstruction.h"

namespace SolveSubjects
{
namespace
{

using CoreOrlexTypes::VSubjectParametrised;
using VTarget = VSubject::VTarget;

void AddPoint(std::mt19937& io_rRandom, std::uint32_t i_Segment, VSubject& io_rSubject)
{
	std::uniform_real_distribution<double> offset(30.0, 120.0);
	const auto marker = static_cast<std::uint32_t>(io_rSubject.m_Markers.size());
	io_rSubject.m_Markers.emplace_back();
	io_rSubject.m_Targets.push_back(Reference::Target(VTarget::ELocalPointToWorldPoint, i_Segment,
	    {offset(io_rRandom), -offset(io_rRandom), offset(io_rRandom) - 75.0}, marker));
}

void AddBody(std::mt19937& io_rRandom, std::uint32_t i_Segment, VSubject& io_rSubject)
{
	AddPoint(io_rRandom, i_Segment, io_rSubject);
	VTarget& rTarget = io_rSubject.m_Targets.back();
	rTarget.m_Type = VTarget::ERigidBody;
	// The body's place, then its markers.
	for (const double value : {0.3, 0.2, -0.1, 40.0, -60.0, 20.0, -50.0, 10.0, 30.0, 20.0, 70.0, -30.0})
		rTarget.m_State.push_back(value);
	for (int i = 0; i < 2; ++i)
	{
		rTarget.m_MarkerIndices.push_back(static_cast<std::uint32_t>(io_rSubject.m_Markers.size()));
		io_rSubject.m_Markers.emplace_back();
	}
}

void AddRotation(std::mt19937& io_rRandom, std::uint32_t i_Segment, VSubject& io_rSubject)
{
	std::uniform_real_distribution<double> angle(-3.5, 3.5);
	const auto rotation = static_cast<std::uint32_t>(io_rSubject.m_Rotations.size());
	io_rSubject.m_Rotations.emplace_back();
	io_rSubject.m_Targets.push_back(Reference::Target(VTarget::ELocalRotationToWorldRotation, i_Segment,
	    {angle(io_rRandom), angle(io_rRandom), angle(io_rRandom)}, rotation));
}

} // namespace

VSubject Tree(std::mt19937& io_rRandom, std::size_t i_Segments, bool i_bBallsOnly)
{
	VSubject subject = Reference::RandomSubject(io_rRandom, i_Segments);
	for (std::uint32_t i = 0; i < i_Segments; ++i)
	{
		auto& rSegment = subject.m_Segments[i];
		if (i == 0)
			rSegment.m_Joint.m_JointType = Reference::VJointTypes::EFree;
		else if (i_bBallsOnly || rSegment.m_Joint.m_JointType == Reference::VJointTypes::EFree)
			rSegment.m_Joint.m_JointType = Reference::VJointTypes::EBall;
		// Chains of up to seven segments from the root or from a segment of another chain.
		if (i > 0 && i % 7 != 1)
			rSegment.m_ParentSegmentIndex = i - 1;
	}
	return subject;
}

std::vector<VCharacter> Characters()
{
	std::vector<VCharacter> characters;
	for (const char* pName : {"heaps_biped_zup_a7100", "kenney_medium_b7400", "own_game_zup_m_b7400",
	         "own_ns_yup_cm_b7400", "pab_arnaud_b7500", "ufbx_maya_human_ik_7400_binary"})
	{
		FBXIO::FBXReader reader;
		if (!reader.LoadFile(RETARGET_TEST_DATA "/fbx/" + std::string(pName) + ".fbx") || !reader.HasSkeleton())
			continue;
		VSubjectParametrised subject;
		CoreOrlexTypes::VSubjectApplicationData data;
		const auto skeleton = *reader.GetSkeleton();
		RetargetSetup::BuildTargetSubject(
		    RetargetSetup::ExtractSubtree(skeleton, RetargetSetup::RootBones(skeleton).front()), subject, data, 0);
		RetargetSetup::SetGlobalScale(subject, 1.0);
		VCharacter character{pName, {}, {}};
		CoreOrlexTypesUtils::SubjectParametrisedConverter::ConvertSubject(subject, character.m_Subject);
		character.m_BindPose = CoreOrlexTypesUtils::PoseVector(subject, &VSubjectParametrised::VJoint::m_BindPose);
		characters.push_back(std::move(character));
	}
	return characters;
}

void SetTargets(std::mt19937& io_rRandom, ETargets i_Targets, VSubject& io_rSubject)
{
	io_rSubject.m_Markers.clear();
	io_rSubject.m_Rotations.clear();
	io_rSubject.m_Targets.clear();
	for (std::uint32_t i = 0; i < io_rSubject.m_Segments.size(); ++i)
	{
		if (i_Targets == ETargets::EPoints || (i_Targets == ETargets::EMixed && i % 2 == 1))
		{
			AddBody(io_rRandom, i, io_rSubject);
			continue;
		}
		AddPoint(io_rRandom, i, io_rSubject);
		AddRotation(io_rRandom, i, io_rSubject);
	}
}

VExactObservations Observe(const VSubject& i_rSubject, const std::vector<double>& i_rStates)
{
	ComputeSubject::VComputeSubjectFK kinematics(i_rSubject);
	kinematics.Update(i_rStates.data());
	std::vector<Rotation::VVector3> positions;
	std::vector<Rotation::VMatrix3> rotations;
	kinematics.ComputeMarkers(positions);
	kinematics.ComputeRotations(rotations);
	VExactObservations observations;
	for (const auto& rPosition : positions)
		observations.m_Positions.insert(observations.m_Positions.end(), rPosition.begin(), rPosition.end());
	for (const auto& rRotation : rotations)
		observations.m_Rotations.insert(observations.m_Rotations.end(), rRotation.begin(), rRotation.end());
	return observations;
}

} // namespace SolveSubjects
