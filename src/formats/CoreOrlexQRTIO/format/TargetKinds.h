#pragma once

#include "CoreOrlexQRTIO/format/FormatTable.h"
#include "CoreOrlexTypes/SubjectParametrised.h"

#include <algorithm>

namespace CoreOrlexQRTIO
{

/// What the six target elements have of their own.
struct VTargetKind
{
	using ETargetType = CoreOrlexTypes::VSubjectParametrised::VTarget::ETargetType;

	const Format::VElement& m_rElement;
	ETargetType m_Type;
	/// EBadTargetType for kinds that are always of one type.
	ETargetType m_GaussianType;
	/// Values before those of the markers of the target's group.
	std::size_t m_StateSize;
	std::size_t m_CovarianceSize;
	/// The observation is a marker; such a target has a template too. Null for the others.
	const Format::VElement* m_pTemplate = nullptr;
	const Format::VAttribute* m_pCovariance = nullptr;
	const Format::VAttribute* m_pTemplateCovariance = nullptr;
	/// State values 0 to 2 of a target of one marker.
	const Format::VAttribute* m_pOrigin = nullptr;
	/// The observation is a rotation. Null for the others.
	const Format::VAttribute* m_pObservation = nullptr;
	const Format::VAttribute* m_pState = nullptr;
	const Format::VAttribute* m_pWeight = nullptr;

	bool HasMarker() const { return m_pTemplate != nullptr; }
	bool HasObservation() const { return m_pObservation != nullptr; }
	bool Is(ETargetType i_Type) const { return i_Type == m_Type || (HasMarker() && i_Type == m_GaussianType); }
};

/// In the order of declaration.
inline constexpr VTargetKind c_TargetKinds[] = {
    {Format::Target::c_Line, CoreOrlexTypes::VSubjectParametrised::VTarget::ELocalLineToWorldPoint,
        CoreOrlexTypes::VSubjectParametrised::VTarget::ELocalLineToWorldPointGaussian, 6, 0,
        &Format::Target::c_LineTemplate, &Format::Target::c_LineCovariance, &Format::Target::c_LineTemplateCovariance,
        &Format::Target::c_LineOrigin},
    {Format::Target::c_Plane, CoreOrlexTypes::VSubjectParametrised::VTarget::ELocalPlaneToWorldPoint,
        CoreOrlexTypes::VSubjectParametrised::VTarget::ELocalPlaneToWorldPointGaussian, 6, 0,
        &Format::Target::c_PlaneTemplate, &Format::Target::c_PlaneCovariance,
        &Format::Target::c_PlaneTemplateCovariance, &Format::Target::c_PlaneOrigin},
    {Format::Target::c_Point, CoreOrlexTypes::VSubjectParametrised::VTarget::ELocalPointToWorldPoint,
        CoreOrlexTypes::VSubjectParametrised::VTarget::ELocalPointToWorldPointGaussian, 3, 0,
        &Format::Target::c_PointTemplate, &Format::Target::c_PointCovariance,
        &Format::Target::c_PointTemplateCovariance, &Format::Target::c_PointPosition},
    {Format::Target::c_RigidBody, CoreOrlexTypes::VSubjectParametrised::VTarget::ERigidBody,
        CoreOrlexTypes::VSubjectParametrised::VTarget::EBadTargetType, 6, 36},
    {Format::Target::c_Rotation, CoreOrlexTypes::VSubjectParametrised::VTarget::ELocalRotationToWorldRotation,
        CoreOrlexTypes::VSubjectParametrised::VTarget::EBadTargetType, 3, 0, nullptr, nullptr, nullptr, nullptr,
        &Format::Target::c_RotationObservation, &Format::Target::c_RotationState, &Format::Target::c_RotationWeight},
    {Format::Target::c_Direction, CoreOrlexTypes::VSubjectParametrised::VTarget::ELocalDirectionToWorldDirection,
        CoreOrlexTypes::VSubjectParametrised::VTarget::EBadTargetType, 3, 0, nullptr, nullptr, nullptr, nullptr,
        &Format::Target::c_DirectionObservation, &Format::Target::c_DirectionState, &Format::Target::c_DirectionWeight},
};

/// Null if there is none.
template <typename TPredicate>
const VTargetKind* FindTargetKind(const TPredicate& i_rPredicate)
{
	const auto* const pFound = std::ranges::find_if(c_TargetKinds, i_rPredicate);
	return pFound == std::ranges::end(c_TargetKinds) ? nullptr : pFound;
}

} // namespace CoreOrlexQRTIO
