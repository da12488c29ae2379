#pragma once

#include "CoreOrlexTypesUtils/SubjectKind.h"

#include "DebugServices/GlobalLog.h"

#include "numerics/MatrixValidity.h"

#include <cmath>
#include <span>

/// What of a target scales; the two subject types share it.
namespace CoreOrlexTypesUtils
{

/// Whether a component of the state of a target of this type is a length.
template <typename TType>
bool IsLength(TType i_Type, std::size_t i_Component)
{
	// The enumerations of the two subject types have the same values.
	using VTarget = CoreOrlexTypes::VSubject::VTarget;
	switch (VTarget::ETargetType(i_Type))
	{
	case VTarget::ELocalPointToWorldPoint:
	case VTarget::ELocalPointToWorldPointGaussian:
	case VTarget::ELocalLineToWorldPoint:
	case VTarget::ELocalLineToWorldPointGaussian: return true;
	// The origin of a plane, before its normal.
	case VTarget::ELocalPlaneToWorldPoint:
	case VTarget::ELocalPlaneToWorldPointGaussian: return i_Component < 3;
	// The position and the markers of a body, but not its orientation.
	case VTarget::ERigidBody: return i_Component < 3 || i_Component >= 6;
	default: return false;
	}
}

/// Tells of types whose state cannot be scaled.
template <typename TSubject>
void TellUnscalableState(const typename TSubject::VTarget& i_rTarget)
{
	using VTarget = typename TSubject::VTarget;
	constexpr const char* c_Category = VSubjectKind<TSubject>::c_LogCategory;
	if (i_rTarget.m_Type == VTarget::EBadTargetType)
		NVX_LOG(c_Category, NVX::ELogError, "Cannot scale bad target");
	// Nothing computes with directions yet, so nothing tells what a scale means to them; they stay as they are.
	else if (i_rTarget.m_Type == VTarget::ELocalDirectionToWorldDirection)
		NVX_LOG(c_Category, NVX::ELogWarning, "Target type not implemented yet. Scaling may be incorrect");
	else if (i_rTarget.m_Type < VTarget::EBadTargetType || i_rTarget.m_Type > VTarget::ELocalDirectionToWorldDirection)
		NVX_LOG(c_Category, NVX::ELogError, "Unknown target type");
}

/// A covariance of t_Size values of which the first are lengths, the rest angles.
template <std::size_t t_Size>
void ScaleCovariance(std::span<double, t_Size * t_Size> io_Covariance, std::size_t i_Lengths, double i_Factor)
{
	for (std::size_t row = 0; row < t_Size; ++row)
		for (std::size_t column = 0; column < t_Size; ++column)
			io_Covariance[row * t_Size + column] *=
			    (row < i_Lengths ? i_Factor : 1.0) * (column < i_Lengths ? i_Factor : 1.0);
	MatrixValidity::TakeOffRounding<t_Size>(io_Covariance);
}

/// The covariances of a target, all of which are given.
template <typename TSubject, typename... TCovariances>
void ScaleTargetStatistics(
    const typename TSubject::VTarget& i_rTarget, double i_Factor, TCovariances&... io_rCovariances)
{
	using VTarget = typename TSubject::VTarget;
	constexpr const char* c_Category = VSubjectKind<TSubject>::c_LogCategory;
	const auto asLengths = [i_Factor](std::vector<double>& io_rCovariance)
	{
		switch (const std::span<double> covariance(io_rCovariance); covariance.size())
		{
		case 4: return ScaleCovariance<2>(covariance.first<4>(), 2, i_Factor);
		case 9: return ScaleCovariance<3>(covariance.first<9>(), 3, i_Factor);
		case 36: return ScaleCovariance<6>(covariance.first<36>(), 6, i_Factor);
		default:
			for (double& rValue : covariance)
				rValue *= i_Factor * i_Factor;
		}
	};
	const auto asBody = [i_Factor, &i_rTarget](std::vector<double>& io_rCovariance)
	{
		const std::size_t markers = i_rTarget.m_MarkerIndices.size();
		if (io_rCovariance.size() != 36 + 9 * markers)
			return;
		const std::span<double> covariance(io_rCovariance);
		ScaleCovariance<6>(covariance.first<36>(), 3, i_Factor);
		for (std::size_t i = 0; i < markers; ++i)
			ScaleCovariance<3>(covariance.subspan(36 + 9 * i).first<9>(), 3, i_Factor);
	};
	switch (i_rTarget.m_Type)
	{
	case VTarget::ELocalPointToWorldPoint:
		if ((io_rCovariances.empty() && ...))
			NVX_LOG(c_Category, NVX::ELogInformation, "LocalPointToWorldPoint targets have no stats to scale.");
		(asLengths(io_rCovariances), ...);
		break;
	case VTarget::ELocalPointToWorldPointGaussian:
	case VTarget::ELocalPlaneToWorldPoint:
	case VTarget::ELocalPlaneToWorldPointGaussian:
	case VTarget::ELocalLineToWorldPoint:
	case VTarget::ELocalLineToWorldPointGaussian: (asLengths(io_rCovariances), ...); break;
	case VTarget::ERigidBody: (asBody(io_rCovariances), ...); break;
	case VTarget::ELocalRotationToWorldRotation:
	case VTarget::ELocalDirectionToWorldDirection: break;
	default: NVX_LOG(c_Category, NVX::ELogError, "Unsupported target type"); break;
	}
}

template <typename TSubject>
bool IsUsableFactor(const TSubject& i_rSubject, double i_Factor)
{
	if (std::isfinite(i_Factor) && i_Factor > 0.0)
		return true;
	NVX_LOG(VSubjectKind<TSubject>::c_LogCategory, NVX::ELogError,
	    "Cannot scale subject %1% by %2%: a scale is a finite number above 0", i_rSubject.m_Name,
	    NumberText::PrintG17(i_Factor));
	return false;
}

} // namespace CoreOrlexTypesUtils
