#pragma once

#include "CoreOrlexTypes/SubjectApplicationData.h"
#include "CoreOrlexTypes/SubjectParametrised.h"
#include "numerics/Rotation.h"

#include <cstdint>
#include <string>
#include <string_view>

namespace ComputeSubject
{
class VComputeSubjectFK;
}

/// Targets relate a segment of the target subject to a segment of the source subject, which they know by its name: the
/// name of a marker for a position target, of a rotation observation for a rotation target. Their state expressions
/// hold where the source segment stands in the target segment's frame while both subjects are in their bind pose: mm
/// over the subject's scale, or an angle-axis.
namespace RetargetSetup
{

/// A target that is to be added, by the indices of its segments.
struct VNewTarget
{
	std::size_t m_Source = 0;
	std::size_t m_Target = 0;
	bool m_bPosition = false;
	double m_Weight = 1.0;
};

/// The word for a kind of target: "Position", "Rotation", or what the type has in the target segment, as "Plane".
std::string TargetKindName(CoreOrlexTypes::VSubjectParametrised::VTarget::ETargetType i_Type);

/// The name of the source segment: of the first marker for a position target, of the first rotation observation for any
/// other. Null if the target names none, or one that is not there.
const std::string* SourceName(const CoreOrlexTypes::VSubjectParametrised& i_rSubject,
    const CoreOrlexTypes::VSubjectParametrised::VTarget& i_rTarget);

/// The name of the first of the target's segments; null if it names none, or one that is not there.
const std::string* TargetSegmentName(const CoreOrlexTypes::VSubjectParametrised& i_rSubject,
    const CoreOrlexTypes::VSubjectParametrised::VTarget& i_rTarget);

/// The first position or rotation target that ties the target segment to a source segment of this name, -1 if none
/// does.
std::int32_t FindTargetPair(const CoreOrlexTypes::VSubjectParametrised& i_rSubject, const std::string& i_rSourceName,
    std::size_t i_TargetSegmentIndex, bool i_bPosition);

/// Appends one target that ties the target segment to the source segment, with the offset that the two have in the
/// present poses. Both kinematics must have the segments of their subjects, and the indices be in range.
/// Tells if the subject has no dynamic parameter to store the offset with.
void AddTargetPair(const ComputeSubject::VComputeSubjectFK& i_rSourceFK,
    const ComputeSubject::VComputeSubjectFK& i_rTargetFK, std::size_t i_SourceSegmentIndex,
    std::size_t i_TargetSegmentIndex, bool i_bPosition, const CoreOrlexTypes::VSubjectParametrised& i_rSource,
    CoreOrlexTypes::VSubjectParametrised& io_rTarget, CoreOrlexTypes::VSubjectApplicationData& io_rApplicationData);

/// Takes the offsets of all targets anew from the present poses. A target whose source segment or target segment is not
/// there keeps its offset, which is told.
void UpdateTargetStates(const ComputeSubject::VComputeSubjectFK& i_rSourceFK,
    const ComputeSubject::VComputeSubjectFK& i_rTargetFK, const CoreOrlexTypes::VSubjectParametrised& i_rSource,
    CoreOrlexTypes::VSubjectParametrised& io_rTarget);

/// The index of the first marker of exactly this name. If there is none, one is appended with its application data.
std::uint32_t FindOrAddMarker(CoreOrlexTypes::VSubjectParametrised& io_rSubject,
    CoreOrlexTypes::VSubjectApplicationData& io_rApplicationData, const std::string& i_rName);

/// The same for rotation observations, which have no application data.
std::uint32_t FindOrAddRotation(CoreOrlexTypes::VSubjectParametrised& io_rSubject,
    CoreOrlexTypes::VSubjectApplicationData& io_rApplicationData, const std::string& i_rName);

/// Stores an offset, the source segment's pose in the target segment's frame: its translation for a position target,
/// its rotation for any other.
void UpdateTargetState(CoreOrlexTypes::VSubjectParametrised& io_rSubject, const Rotation::VPose<double>& i_rRelative,
    std::size_t i_TargetIndex);

/// Stores what an operator types for component 0, 1 or 2 of an offset. For point targets the text must be a number, of
/// millimetres at the present scale; it is stored divided by the value of the last dynamic parameter and times its
/// name. For rotation targets it may be any expression, and is stored without its blanks. An empty text counts as 0.
/// @return false, with nothing stored, for a target or component that is not there, a target of another type, a subject
/// without dynamic parameters, and for a text that is no such number or expression or has no finite value; the last
/// three are told.
bool SetStateExpression(CoreOrlexTypes::VSubjectParametrised& io_rSubject, std::string_view i_Text,
    std::size_t i_TargetIndex, std::size_t i_Component);

/// Erases an element of both target lists, and the markers and rotation observations that no target names any more.
/// The index must be in range.
void RemoveTarget(CoreOrlexTypes::VSubjectParametrised& io_rSubject,
    CoreOrlexTypes::VSubjectApplicationData& io_rApplicationData, std::size_t i_TargetIndex);

/// The name without "Left", "left", "Right", "right" and without the letters l, L, r, R at its ends.
std::string SideNeutralName(std::string i_Name);

/// The first other segment with the same side-neutral name, -1 if there is none.
std::int32_t FindMirrorSegment(const CoreOrlexTypes::VSubjectParametrised& i_rSubject, std::size_t i_SegmentIndex);

} // namespace RetargetSetup
