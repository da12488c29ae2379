#pragma once

#include "CoreOrlexTypes/JointType.h"
#include "CoreOrlexTypes/NameHash.h"
#include "CoreOrlexTypes/SubjectApplicationData.h"
#include "CoreOrlexTypesUtils/convert/SubjectParametrisedConverter.h"

#include "ComputeSubjectFK/ComputeSubjectFK.h"
#include "ComputeSubjectFK/TargetFKInterfaces.h"
#include "math/NumberText.h"

#include <algorithm>
#include <map>
#include <random>

/// Random subjects that are in order: every joint and target type with a class, lengths as numbers, over static
/// parameters of every kind and over a dynamic one, application data that goes with them.
class VRandomSubject
{
public:
	using VSubjectParametrised = CoreOrlexTypes::VSubjectParametrised;
	using VTarget = VSubjectParametrised::VTarget;
	using VJoint = VSubjectParametrised::VJoint;

	explicit VRandomSubject(unsigned i_Seed) : m_Generator(i_Seed) {}

	void Make(VSubjectParametrised& o_rSubject, CoreOrlexTypes::VSubjectApplicationData& o_rAppData)
	{
		o_rSubject = {};
		o_rAppData = {};
		o_rSubject.m_Name = "Performer";
		for (const char* pName : {"Arm", "Twice", "Sum", "Angle", "Prior"})
			o_rSubject.m_StaticParameters.emplace_back().m_Name = pName;
		o_rSubject.m_StaticParameters[0].m_UserValue = 120;
		o_rSubject.m_StaticParameters[1].m_DefaultExpression = "2*Arm";
		o_rSubject.m_StaticParameters[2].m_DefaultExpression = "Twice+35";
		o_rSubject.m_StaticParameters[3].m_UserValue = 0.4;
		o_rSubject.m_StaticParameters[4].m_Prior = 80;
		o_rSubject.m_DynamicParameters = {{"GlobalScale", 1.25, 0, 1.25, true}};
		for (std::uint32_t i = 0, count = 1 + Below(8); i < count; ++i)
			AddSegment(o_rSubject, i);
		for (std::uint32_t i = 0, count = 4 + Below(8); i < count; ++i)
		{
			auto& rMarker = o_rSubject.m_Markers.emplace_back();
			rMarker.m_Name = std::string("M").append(std::to_string(i));
			rMarker.m_MarkerId = CoreOrlexTypes::HashName(rMarker.m_Name);
		}
		o_rSubject.m_Rotations = {{"R0", 0}, {"R1", 1}};
		for (std::uint32_t i = 0; i < o_rSubject.m_Markers.size(); ++i)
			AddTarget(o_rSubject, VTarget::ETargetType(1 + i % 6), {i}, {});
		for (int i = 0; i < 3; ++i)
			AddTarget(o_rSubject, VTarget::ELocalPointToWorldPoint,
			    {std::uint32_t(Below(std::uint32_t(o_rSubject.m_Markers.size())))}, {});
		AddTarget(o_rSubject, VTarget::ERigidBody, {0, 1, 2, 3}, {});
		AddTarget(o_rSubject, VTarget::ELocalRotationToWorldRotation, {}, {0});
		AddTarget(o_rSubject, VTarget::ELocalRotationToWorldRotation, {}, {1});
		std::shuffle(o_rSubject.m_Targets.begin(), o_rSubject.m_Targets.end(), m_Generator);
		FillAppData(o_rSubject, o_rAppData);
	}

	/// A rigid body in the layout of one target, with as many dummy segments as given, on the last of which it stands.
	void MakeBody(
	    VSubjectParametrised& o_rBody, CoreOrlexTypes::VSubjectApplicationData& o_rAppData, std::uint32_t i_Dummies = 0)
	{
		o_rBody = {};
		o_rAppData = {};
		o_rBody.m_Name = "Prop";
		for (std::uint32_t i = 0; i < 1 + i_Dummies; ++i)
			AddSegment(o_rBody, i, i == 0 ? VJoint::EFree : VJoint::EDummy);
		o_rBody.m_Segments[0].m_Name = "Root";
		o_rBody.m_Segments[0].m_Joint.m_Name = "RootJoint";
		for (auto& rSegment : o_rBody.m_Segments)
		{
			for (auto* pTexts : {&rSegment.m_PreRotation, &rSegment.m_PreTranslation})
				for (std::string& rText : *pTexts)
					rText = Number(1);
			rSegment.m_Bounds[4] = Number(1);
		}
		std::vector<std::uint32_t> markers;
		for (std::uint32_t i = 0, count = 3 + Below(4); i < count; ++i)
		{
			o_rBody.m_Markers.emplace_back().m_Name = std::string("P").append(std::to_string(i));
			o_rBody.m_Markers.back().m_MarkerId = i;
			markers.push_back(i);
		}
		AddTarget(o_rBody, VTarget::ERigidBody, markers, {});
		for (std::string& rText : o_rBody.m_Targets[0].m_StateExpressions)
			rText = Number(2);
		o_rBody.m_Targets[0].m_SegmentIndices = {i_Dummies};
		FillAppData(o_rBody, o_rAppData);
	}

	std::uint32_t Below(std::uint32_t i_Limit) { return std::uint32_t(m_Generator() % i_Limit); }
	double Real(double i_Limit) { return std::uniform_real_distribution<double>(-i_Limit, i_Limit)(m_Generator); }
	std::string Number(double i_Limit) { return NumberText::PrintG17(Real(i_Limit)); }

private:
	std::string Length()
	{
		static constexpr const char* c_Lengths[] = {"Arm", "2*Arm-Twice/4", "Sum", "Prior*0.5", "Prior+10",
		    "3*GlobalScale", "Arm*GlobalScale", "Twice*Angle", "", "0", "(Arm+7)*2"};
		const std::uint32_t choice = Below(16);
		return choice < std::size(c_Lengths) ? c_Lengths[choice] : Number(300);
	}

	std::string AngleText() { return Below(6) ? Number(1.5) : "Angle*0.5"; }

	std::vector<double> Definite(std::size_t i_Size)
	{
		std::vector<double> matrix(i_Size * i_Size);
		for (std::size_t i = 0; i < i_Size; ++i)
		{
			matrix[i * (i_Size + 1)] = double(i_Size + Below(8));
			for (std::size_t j = 0; j < i; ++j)
				matrix[i * i_Size + j] = matrix[j * i_Size + i] = 0.25 * (double((5 * i + 3 * j) % 7) - 3.0);
		}
		return matrix;
	}

	/// Half of them on the edge, where rounding makes an eigenvalue negative.
	std::vector<double> Semidefinite(std::size_t i_Size)
	{
		if (Below(2))
			return Definite(i_Size);
		std::vector<double> matrix(i_Size * i_Size, 0.0);
		for (std::size_t i = 0; i < i_Size; ++i)
			matrix[i * (i_Size + 1)] = i == 0 ? 3 : Below(3);
		return matrix;
	}

	void AddSegment(VSubjectParametrised& io_rSubject, std::uint32_t i_Index)
	{
		AddSegment(io_rSubject, i_Index, i_Index == 0 ? VJoint::EFree : VJoint::EJointType(Below(6)));
	}

	void AddSegment(VSubjectParametrised& io_rSubject, std::uint32_t i_Index, VJoint::EJointType i_Type)
	{
		auto& rSegment = io_rSubject.m_Segments.emplace_back();
		rSegment.m_Name = std::string("S").append(std::to_string(i_Index));
		rSegment.m_SegmentIndex = i_Index;
		if (i_Index > 0)
		{
			rSegment.m_ParentSegmentIndex = Below(i_Index);
			rSegment.m_TreeDepth = io_rSubject.m_Segments[rSegment.m_ParentSegmentIndex].m_TreeDepth + 1;
		}
		for (int i = 0; i < 3; ++i)
		{
			rSegment.m_PreRotation[i] = AngleText();
			rSegment.m_PreTranslation[i] = Length();
			rSegment.m_InversePostRotation[i] = Real(0.3);
			rSegment.m_InversePostTranslation[i] = Real(20);
			rSegment.m_Joint.m_JointOrientation[i] = Real(1);
		}
		rSegment.m_Bounds[4] = Length();
		VJoint& rJoint = rSegment.m_Joint;
		rJoint.m_Name = rSegment.m_Name + "Joint";
		rJoint.m_JointType = i_Type;
		const std::size_t size = CoreOrlexTypes::StateSize(i_Type);
		rJoint.m_Covariance = rJoint.m_TemplateCovariance = Definite(size);
		for (std::size_t i = 0; i < size; ++i)
			rJoint.m_Mean.push_back(i < 3 && i_Type != VJoint::ESlider ? Real(1) : Real(500));
		rJoint.m_TemplateMean = rJoint.m_BindPose = rJoint.m_Mean;
	}

	void AddTarget(VSubjectParametrised& io_rSubject, VTarget::ETargetType i_Type, std::vector<std::uint32_t> i_Markers,
	    std::vector<std::uint32_t> i_Rotations)
	{
		VTarget& rTarget = io_rSubject.m_Targets.emplace_back();
		rTarget.m_Type = i_Type;
		rTarget.m_Weight = 0.5 + Below(4);
		rTarget.m_SegmentIndices = {Below(std::uint32_t(io_rSubject.m_Segments.size()))};
		rTarget.m_ViewNormals.assign(i_Markers.size(), {0, 0.6, -0.8});
		const bool bPoint = i_Type <= VTarget::ELocalPointToWorldPointGaussian;
		const bool bRotation = i_Type == VTarget::ELocalRotationToWorldRotation;
		const std::size_t size = bPoint || bRotation ? 3 : i_Type == VTarget::ERigidBody ? 6 + 3 * i_Markers.size() : 6;
		const bool bLine =
		    i_Type == VTarget::ELocalLineToWorldPoint || i_Type == VTarget::ELocalLineToWorldPointGaussian;
		for (std::size_t i = 0; i < size; ++i)
			rTarget.m_StateExpressions.push_back(
			    bRotation || (!bPoint && !bLine && i >= 3 && i < 6) ? AngleText() : Length());
		if (i_Type == VTarget::ELocalPlaneToWorldPointGaussian)
			rTarget.m_Covariance = rTarget.m_TemplateCovariance = {4};
		else if (i_Type == VTarget::ELocalLineToWorldPointGaussian)
			rTarget.m_Covariance = rTarget.m_TemplateCovariance = {4, 1, 1, 4};
		else if (i_Type == VTarget::ELocalPointToWorldPointGaussian || i_Type == VTarget::ERigidBody)
		{
			rTarget.m_Covariance = Semidefinite(i_Type == VTarget::ERigidBody ? 6 : 3);
			for (std::size_t i = 0; i_Type == VTarget::ERigidBody && i < i_Markers.size(); ++i)
			{
				const std::vector<double> block = Semidefinite(3);
				rTarget.m_Covariance.insert(rTarget.m_Covariance.end(), block.begin(), block.end());
			}
			rTarget.m_TemplateCovariance = rTarget.m_Covariance;
		}
		rTarget.m_MarkerIndices = std::move(i_Markers);
		rTarget.m_RotationObservationIndices = std::move(i_Rotations);
	}

	void FillAppData(const VSubjectParametrised& i_rSubject, CoreOrlexTypes::VSubjectApplicationData& o_rAppData)
	{
		o_rAppData.m_Segments.resize(i_rSubject.m_Segments.size());
		// The colour tells which marker or target an entry belongs to.
		for (const auto& rMarker : i_rSubject.m_Markers)
			o_rAppData.m_Markers.push_back(
			    {CoreOrlexTypes::ColourFromPattern(CoreOrlexTypes::HashName(rMarker.m_Name))});
		for (const auto& rTarget : i_rSubject.m_Targets)
			o_rAppData.m_Targets.emplace_back().m_FillGaps = rTarget.m_Type == VTarget::ERigidBody;
		for (int i = 0; i < 5; ++i)
			o_rAppData.m_Sticks.push_back({Below(std::uint32_t(i_rSubject.m_Markers.size())), {},
			    Below(std::uint32_t(i_rSubject.m_Markers.size())), {}});
	}

	std::mt19937 m_Generator;
};

using VPoints = std::vector<Rotation::VVector3>;

/// Where each target sees its markers in the world, all joints in their Mean: of each marker name the points of point
/// targets, of rigid bodies and of lines, in the order of the targets; of rotations by name the columns.
inline std::map<std::string, VPoints> WorldPoints(const CoreOrlexTypes::VSubject& i_rSubject)
{
	ComputeSubject::VComputeSubjectFK fk(i_rSubject);
	std::vector<double> state;
	for (const auto& rSegment : i_rSubject.m_Segments)
		state.insert(state.end(), rSegment.m_Joint.m_Mean.begin(), rSegment.m_Joint.m_Mean.end());
	std::map<std::string, VPoints> points;
	if (fk.NumberOfSegments() == 0 || fk.NumberOfStates() != state.size())
		return points;
	fk.Update(state.data());
	for (std::size_t i = 0; i < fk.NumberOfTargets(); ++i)
	{
		const auto& rTarget = i_rSubject.m_Targets[i];
		const auto* const pTarget = fk.Target(i);
		if (pTarget->FromLocalPoint())
			points[i_rSubject.m_Markers[rTarget.m_MarkerIndices[0]].m_Name].push_back(
			    pTarget->FromLocalPoint()->WorldPoint());
		if (pTarget->FromLocalLine())
			points[i_rSubject.m_Markers[rTarget.m_MarkerIndices[0]].m_Name].push_back(
			    pTarget->FromLocalLine()->WorldPoint2());
		for (std::size_t j = 0; pTarget->FromPointGroup() && j < rTarget.m_MarkerIndices.size(); ++j)
			points[i_rSubject.m_Markers[rTarget.m_MarkerIndices[j]].m_Name].push_back(
			    pTarget->FromPointGroup()->WorldPoint(j));
		if (pTarget->FromLocalRotation())
			for (std::size_t j = 0; j < 3; ++j)
			{
				const auto& rR = pTarget->FromLocalRotation()->WorldRotation();
				points[i_rSubject.m_Rotations[rTarget.m_RotationObservationIndices[0]].m_Name].push_back(
				    {rR[j], rR[3 + j], rR[6 + j]});
			}
	}
	return points;
}

inline std::map<std::string, VPoints> WorldPoints(const CoreOrlexTypes::VSubjectParametrised& i_rSubject)
{
	CoreOrlexTypes::VSubject evaluated;
	CoreOrlexTypesUtils::SubjectParametrisedConverter::ConvertSubject(i_rSubject, evaluated);
	return WorldPoints(evaluated);
}

/// How uncertain the targets are of each marker, and from where they see it, in the world: of each marker name the
/// covariances of points and rigid bodies (9 values) and the view normals, of each body its pose's covariance (36),
/// with the orientation's part about its own axes.
inline std::map<std::string, std::vector<double>> WorldSights(const CoreOrlexTypes::VSubject& i_rSubject)
{
	using Rotation::VMatrix3;
	ComputeSubject::VComputeSubjectFK fk(i_rSubject);
	std::vector<double> state;
	for (const auto& rSegment : i_rSubject.m_Segments)
		state.insert(state.end(), rSegment.m_Joint.m_Mean.begin(), rSegment.m_Joint.m_Mean.end());
	fk.Update(state.data());
	std::map<std::string, std::vector<double>> sights;
	// Left C Right', of the block at an entry of a matrix of that many columns.
	const auto add = [](std::vector<double>& io_rSight, const VMatrix3& i_rLeft, const VMatrix3& i_rRight,
	                     const std::vector<double>& i_rMatrix, std::size_t i_Begin, std::size_t i_Columns)
	{
		VMatrix3 block;
		for (std::size_t i = 0; i < 9; ++i)
			block[i] = i_rMatrix[i_Begin + i / 3 * i_Columns + i % 3];
		block = Rotation::Product(i_rLeft, Rotation::Product(block, Rotation::Transposed(i_rRight)));
		io_rSight.insert(io_rSight.end(), block.begin(), block.end());
	};
	for (const auto& rTarget : i_rSubject.m_Targets)
	{
		using VTarget = CoreOrlexTypes::VSubject::VTarget;
		const auto& rSegment = fk.Segment(rTarget.m_SegmentIndices[0]);
		const VMatrix3 world = Rotation::Product(rSegment.WorldPose().R, rSegment.PostPose().R);
		const bool bBody = rTarget.m_Type == VTarget::ERigidBody;
		const VMatrix3 body = bBody
		    ? Rotation::RotationMatrixFromAngleAxis({rTarget.m_State[3], rTarget.m_State[4], rTarget.m_State[5]})
		    : Rotation::c_Identity3;
		for (std::size_t i = 0; i < rTarget.m_MarkerIndices.size(); ++i)
		{
			auto& rSight = sights[i_rSubject.m_Markers[rTarget.m_MarkerIndices[i]].m_Name];
			const Rotation::VVector3 normal = Rotation::Product(world, rTarget.m_ViewNormals[i]);
			rSight.insert(rSight.end(), normal.begin(), normal.end());
			const VMatrix3 toWorld = Rotation::Product(world, body);
			if (bBody || rTarget.m_Type == VTarget::ELocalPointToWorldPointGaussian)
				add(rSight, toWorld, toWorld, rTarget.m_Covariance, bBody ? 36 + 9 * i : 0, 3);
		}
		if (!bBody)
			continue;
		auto& rPose = sights["pose of " + i_rSubject.m_Markers[rTarget.m_MarkerIndices[0]].m_Name];
		add(rPose, world, world, rTarget.m_Covariance, 0, 6);
		add(rPose, world, Rotation::c_Identity3, rTarget.m_Covariance, 3, 6);
		add(rPose, Rotation::c_Identity3, world, rTarget.m_Covariance, 18, 6);
		add(rPose, Rotation::c_Identity3, Rotation::c_Identity3, rTarget.m_Covariance, 21, 6);
	}
	return sights;
}

/// @param i_bTemplate the template covariances.
inline std::map<std::string, std::vector<double>> WorldSights(
    CoreOrlexTypes::VSubjectParametrised i_Subject, bool i_bTemplate)
{
	for (auto& rTarget : i_Subject.m_Targets)
		if (i_bTemplate)
			rTarget.m_Covariance = rTarget.m_TemplateCovariance;
	CoreOrlexTypes::VSubject evaluated;
	CoreOrlexTypesUtils::SubjectParametrisedConverter::ConvertSubject(i_Subject, evaluated);
	return WorldSights(evaluated);
}
