#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <vector>

namespace CoreOrlexQRTIO
{

/// What a skeleton file has and the subject types have no field for, so that a file that is read and written again
/// keeps it. Texts are as the file has them; an empty text or list was not there. A record belongs to the element of
/// the same name in the subject that was read with it, so that extras stay usable while the subject is edited: the
/// writer takes from them only what still yields the values that the subject holds.
struct VSubjectQRTExtras
{
	struct VJoint
	{
		std::string m_Signs;
		std::string m_Labels;
		std::string m_EditPoseMean;
		std::string m_TPose;
		std::string m_Bounds;
		/// The joint has a share of the subject's T-pose constraints.
		bool m_bHasT = false;
		/// One axis (3 values) or a pair of axes (6), not normalised.
		std::vector<double> m_Axis;
		/// The pose of the child segment in the joint's frame, as files up to 3.1 tell it: 3 expressions each, or none.
		std::vector<std::string> m_PostOrientation;
		std::vector<std::string> m_PostPosition;
		/// The template's own pose of the child segment: 3 values each, or none. Radians and millimetres.
		std::vector<double> m_TemplateInversePostOrientation;
		std::vector<double> m_TemplateInversePostPosition;
		std::vector<double> m_TemplatePostOrientation;
		std::vector<double> m_TemplatePostPosition;

		bool operator==(const VJoint&) const = default;
	};

	struct VSegment
	{
		std::string m_Name;
		std::string m_Covariance;
		std::string m_Size;
		VJoint m_Joint;

		bool operator==(const VSegment&) const = default;
	};

	struct VMarker
	{
		std::string m_Name;
		std::string m_Descriptor;
		/// The marker's own position in its segment where its template has one too, which then stands in the target:
		/// 3 expressions each, or none.
		std::vector<std::string> m_Position;
		std::vector<std::string> m_TemplatePosition;
		std::string m_TemplatePlacementCovariance;

		bool operator==(const VMarker&) const = default;
	};

	struct VTarget
	{
		std::string m_Name;
		/// One axis (3 values) or a pair of axes (6), not normalised.
		std::vector<double> m_Axis;

		bool operator==(const VTarget&) const = default;
	};

	/// One direction in which the parameters of some joints vary together.
	struct VPrincipalComponent
	{
		std::string m_Name;
		std::vector<double> m_JointParams;
		double m_SqrtEigenvalue = 0.0;
		double m_LowerBound = 0.0;
		double m_UpperBound = 0.0;
		double m_TemporalDerivativeSd = 0.0;

		bool operator==(const VPrincipalComponent&) const = default;
	};

	/// Joints that are controlled together, by name, with the mean of their states one after the other.
	struct VDynamicSubspace
	{
		std::string m_Name;
		std::string m_Version;
		std::vector<std::string> m_JointNames;
		std::vector<double> m_JointParamsMean;
		std::vector<VPrincipalComponent> m_Components;

		bool operator==(const VDynamicSubspace&) const = default;
	};

	std::vector<VSegment> m_Segments;
	std::vector<VMarker> m_Markers;
	std::vector<VTarget> m_Targets;
	std::vector<VDynamicSubspace> m_DynamicSubspaces;
	/// The subject that the subspaces were made for, and a hash of its structure.
	std::uint32_t m_SubspaceId = 0;
	std::uint32_t m_SubspaceHash = 0;

	bool operator==(const VSubjectQRTExtras&) const = default;
};

} // namespace CoreOrlexQRTIO
