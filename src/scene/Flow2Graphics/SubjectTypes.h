#pragma once

#include "NVX/ISelectionItem.h"
#include "OrlexGraphics/picking/SelectionKinds.h"

#include <array>
#include <cstddef>
#include <cstdint>

namespace Flow2TypesUtils
{
class VTaggedCoreTypeExtractor;
}

namespace Flow2Graphics
{

/// The classes of subjects, each of which has a list of its own in the scene, in the order of drawing.
enum ESubjectClass : std::size_t
{
	ESubjectClassProp,
	ESubjectClassLabelling,
	ESubjectClassRigidObject,
	ESubjectClassSolving,
	ESubjectClassRetargeting,
	ESubjectClassCount
};

/// What a class of subjects consists of: tags of the items that it comes in, 0 where there is no such item, and the
/// kinds of its selection items. No two classes share a kind, since subjects of two classes may share an id.
struct VSubjectTypes
{
	ESubjectClass m_Class;
	std::uint32_t m_Subject;
	std::uint32_t m_ApplicationData;
	std::uint32_t m_Parametrised;
	std::uint32_t m_Pose;
	std::uint32_t m_Labels;
	/// Tells props from subjects.
	std::uint32_t m_Settings;
	std::uint32_t m_SubjectKind;
	std::uint32_t m_SegmentKind;
	std::uint32_t m_TargetKind;
	std::uint32_t m_MarkerKind;
};

struct VFlowPropTypes
{
	static constexpr VSubjectTypes c_Types{ESubjectClassProp, 4114, 4115, 4122, 4113, 4111, 4135, 8, 9, 10, 12};
};

struct VFlowSubjectTypes
{
	static constexpr VSubjectTypes c_Types{ESubjectClassLabelling, 4114, 4115, 4122, 4113, 4111, 4135,
	    OrlexGraphics::ESelectionSubject, NVX::ESelectionSourceSegment, 13, 15};
};

struct VFlowRigidObjectTypes
{
	static constexpr VSubjectTypes c_Types{ESubjectClassRigidObject, 4149, 4150, 0, 4148, 4111, 0, 17, 18, 19, 20};
};

struct VFlowSubjectForSolvingTypes
{
	static constexpr VSubjectTypes c_Types{ESubjectClassSolving, 4123, 4124, 4140, 4125, 4127, 0, 21,
	    NVX::ESelectionTargetSegment, NVX::ESelectionTarget, 22};
};

struct VFlowSubjectForRetargetingTypes
{
	static constexpr VSubjectTypes c_Types{ESubjectClassRetargeting, 4152, 4153, 0, 4154, 0, 0, 23, 24, 25, 26};
};

inline constexpr std::array<VSubjectTypes, ESubjectClassCount> c_SubjectTypes{VFlowPropTypes::c_Types,
    VFlowSubjectTypes::c_Types, VFlowRigidObjectTypes::c_Types, VFlowSubjectForSolvingTypes::c_Types,
    VFlowSubjectForRetargetingTypes::c_Types};

/// Whether a subject that came under the class's tag belongs to it. Subjects and props come alike; one that nothing
/// was set for is no prop. The settings' tag must have been inserted.
bool IsOfClass(const Flow2TypesUtils::VTaggedCoreTypeExtractor& i_rItems, const VSubjectTypes& i_rTypes,
    std::uint32_t i_SubjectId);

/// Makes the selection items of a subject and of what it consists of. They carry no name, as the rows of lists do not:
/// a row and what is drawn are one item.
class ISubjectSelectionMaker
{
public:
	virtual ~ISubjectSelectionMaker() = default;

	virtual const VSubjectTypes& Types() const = 0;

	NVX::ISelectionItem Subject(std::uint32_t i_SubjectId) const { return {Types().m_SubjectKind, i_SubjectId, 0, {}}; }
	NVX::ISelectionItem Segment(std::uint32_t i_SubjectId, std::size_t i_Index) const
	{
		return {Types().m_SegmentKind, i_SubjectId, static_cast<std::uint32_t>(i_Index), {}};
	}
	NVX::ISelectionItem Target(std::uint32_t i_SubjectId, std::size_t i_Index) const
	{
		return {Types().m_TargetKind, i_SubjectId, static_cast<std::uint32_t>(i_Index), {}};
	}
	NVX::ISelectionItem Marker(std::uint32_t i_SubjectId, std::size_t i_Index) const
	{
		return {Types().m_MarkerKind, i_SubjectId, static_cast<std::uint32_t>(i_Index), {}};
	}
};

template <typename T>
class VSubjectSelectionMaker final : public ISubjectSelectionMaker
{
public:
	const VSubjectTypes& Types() const override { return T::c_Types; }
};

} // namespace Flow2Graphics
