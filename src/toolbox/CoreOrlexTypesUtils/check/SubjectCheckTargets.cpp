#include "CoreOrlexTypesUtils/check/SubjectCheckRemedies.h"
#include "CoreOrlexTypesUtils/check/SubjectCheckRules.h"

#include "CoreOrlexTypes/Fields.h"

#include <cmath>

namespace CoreOrlexTypesUtils::SubjectCheck
{
namespace
{

constexpr std::size_t c_AnySize = ~std::size_t(0);

/// What a type of target asks for; a rigid body's numbers of values follow from its number of markers.
struct VTypeRules
{
	/// As the messages of the sizes spell it.
	const char* m_pName;
	std::size_t m_Markers;
	std::size_t m_Rotations;
	std::size_t m_State;
	std::size_t m_Covariance;
	std::size_t m_TemplateCovariance;
	bool m_bTemplateMayBeEmpty;
};

/// By type.
constexpr VTypeRules c_Rules[] = {
    {"EBadTargetType", 0, 0, 0, c_AnySize, c_AnySize, true},
    {"ELocalPointToWorldPoint", 1, 0, 3, c_AnySize, 9, true},
    {"ELocalPointToWorldPointGaussian", 1, 0, 3, 9, 9, true},
    {"ELocalPlaneToWorldPoint", 1, 0, 6, c_AnySize, 0, true},
    {"ELocalPlaneToWorldPointGaussian", 1, 0, 6, 1, 1, false},
    {"ELocalLineToWorldPoint", 1, 0, 6, c_AnySize, 0, true},
    {"ELocalLineToWorldPointGaussian", 1, 0, 6, 4, 4, false},
    {"ERigidBody", 3, 0, 0, 0, 0, true},
    {"ElocalRotationToWorldRotation", 0, 1, 3, 0, 0, true},
    {"ELocalDirectionToWorldDirection", 0, 1, 3, 0, 0, true},
};

/// Null for a type that there is not.
template <typename EType>
const VTypeRules* FindRules(EType i_Type)
{
	const auto index = static_cast<std::uint32_t>(i_Type);
	return index < std::size(c_Rules) ? &c_Rules[index] : nullptr;
}

bool FailType(const VReport& i_rReport)
{
	return i_rReport.Fail("Unknown target type", "Give the target one of the types 0 to 9.");
}

constexpr std::size_t RigidBodyCovarianceSize(std::size_t i_MarkerCount)
{
	return 36 + 9 * i_MarkerCount;
}

std::string WhatAsks(VSubjectParametrised::VTarget::ETargetType i_Type)
{
	return "target type " + std::string(CoreOrlexTypes::EnumeratorName(i_Type));
}

bool CheckMatrix3(const std::string& i_rField, const double* i_pFirst, const char* i_pMessage, const VReport& i_rReport)
{
	const MatrixValidity::EFault fault =
	    MatrixValidity::FaultAsSemidefinite<3>(std::span<const double, 9>(i_pFirst, 9));
	return fault == MatrixValidity::EFault::ENone || i_rReport.Fail(i_pMessage, MatrixRemedy(i_rField, fault, false));
}

/// The blocks of a rigid body's markers stand behind that of its pose.
bool CheckMarkerBlocks(const std::string& i_rField, const std::vector<double>& i_rValues, std::size_t i_MarkerCount,
    const char* i_pMessage, const VReport& i_rReport)
{
	return i_rReport.Findings().ForEach(i_MarkerCount,
	    [&](std::size_t i_Marker)
	    {
		    return CheckMatrix3("the block of marker " + std::to_string(i_Marker) + " in " + i_rField,
		        i_rValues.data() + RigidBodyCovarianceSize(i_Marker), i_pMessage, i_rReport);
	    });
}

/// The rules that are particular to the type of one target, in steps.
class VTypeCheck
{
public:
	VTypeCheck(const VSubject::VTarget& i_rTarget, const VTypeRules& i_rRules, const VReport& i_rReport)
	    : m_rTarget(i_rTarget), m_rRules(i_rRules), m_rReport(i_rReport),
	      m_bRigidBody(i_rTarget.m_Type == VSubject::VTarget::ERigidBody)
	{
	}

	bool Markers() const
	{
		const std::size_t count = m_rTarget.m_MarkerIndices.size();
		if (m_bRigidBody ? count >= m_rRules.m_Markers : count == m_rRules.m_Markers)
			return true;
		const std::string least = m_bRigidBody ? "at least " : "";
		return Fail("number of markers", least + Count(m_rRules.m_Markers, "marker", "markers"),
		    "Let MarkerIndices name " + least + Count(m_rRules.m_Markers, "marker", "markers") + "; it names "
		        + std::to_string(count) + ".");
	}

	/// Types that ask for an observation pass with another number.
	bool Rotations() const
	{
		const std::size_t count = m_rTarget.m_RotationObservationIndices.size();
		if (count == m_rRules.m_Rotations)
			return true;
		const std::string expected = Count(m_rRules.m_Rotations, "rotation observation", "rotation observations");
		const std::string message = Message("number of rotation observations", expected);
		const std::string remedy =
		    "Let RotationObservationIndices name " + expected + "; it names " + std::to_string(count) + ".";
		return m_rRules.m_Rotations == 0 ? m_rReport.Fail(message, remedy) : m_rReport.Tolerate(message, remedy);
	}

	bool Segments() const
	{
		const std::size_t count = m_rTarget.m_SegmentIndices.size();
		return count == 1
		    || Fail("number of parent segments", "1 segment",
		        "Let SegmentIndices name 1 segment; it names " + std::to_string(count) + ".");
	}

	bool State() const
	{
		if (!m_bRigidBody)
			return Size("state size", "StateExpressions", m_rTarget.m_State.size(), m_rRules.m_State);
		return Size("state size", "StateExpressions", m_rTarget.m_State.size(),
		    3 * (m_rTarget.m_MarkerIndices.size() + 2), "3*(MarkerCount+2)");
	}

	/// The size, and the values of those that are covariances of points.
	bool Covariance() const
	{
		constexpr const char* c_pInvalid = "Invalid target covariance matrix";
		const std::vector<double>& rValues = m_rTarget.m_Covariance;
		const std::size_t markerCount = m_rTarget.m_MarkerIndices.size();
		if (m_bRigidBody)
			return Size("covariance size", "Covariance", rValues.size(), RigidBodyCovarianceSize(markerCount),
			           "36 + 9*MarkerCount")
			    && CheckMarkerBlocks("Covariance", rValues, markerCount, c_pInvalid, m_rReport);
		if (m_rRules.m_Covariance == c_AnySize)
			return true;
		return Size("covariance size", "Covariance", rValues.size(), m_rRules.m_Covariance)
		    && (rValues.size() != 9 || CheckMatrix3("Covariance", rValues.data(), c_pInvalid, m_rReport));
	}

	bool UnitDirection() const
	{
		if (m_rTarget.m_State.size() != m_rRules.m_State)
			return true;
		double square = 0.0;
		for (const double value : m_rTarget.m_State)
			square += value * value;
		return std::abs(square - 1.0) <= 0.001
		    || m_rReport.Fail(
		        "Direction should be a unit vector", "Divide the three values of the state by its length.");
	}

private:
	std::string Message(const std::string& i_rWhat, const std::string& i_rExpected) const
	{
		return "Incorrect " + i_rWhat + ", " + m_rRules.m_pName + " type expects " + i_rExpected;
	}

	bool Fail(const std::string& i_rWhat, const std::string& i_rExpected, std::string i_Remedy) const
	{
		return m_rReport.Fail(Message(i_rWhat, i_rExpected), std::move(i_Remedy));
	}

	/// @param i_rText the expected size as the message tells it; a number if empty.
	bool Size(const char* i_pWhat, const char* i_pField, std::size_t i_Actual, std::size_t i_Expected,
	    const std::string& i_rText = {}) const
	{
		if (i_Actual == i_Expected)
			return true;
		return Fail(i_pWhat, "size " + (i_rText.empty() ? std::to_string(i_Expected) : i_rText),
		    SizeRemedy(i_pField, i_Actual, i_Expected, false,
		        WhatAsks(VSubjectParametrised::VTarget::ETargetType(m_rTarget.m_Type))));
	}

	const VSubject::VTarget& m_rTarget;
	const VTypeRules& m_rRules;
	const VReport& m_rReport;
	bool m_bRigidBody;
};

/// For rotations: how they may be calibrated, and the orientation that this takes.
template <typename TTarget>
bool CheckBehaviour(const TTarget& i_rTarget, const VReport& i_rReport)
{
	const std::size_t size = i_rTarget.m_RotationTargetOrientation.size();
	const auto remedy = [&](std::size_t i_Expected)
	{ return SizeRemedy("RotationTargetOrientation", size, i_Expected, false, "RotationCalibrationBehaviour"); };
	if (i_rTarget.m_RotationCalibrationBehaviour == TTarget::EBadBehaviourType)
		return i_rReport.Fail("Invalid rotation calibration behaviour",
		    "Set RotationCalibrationBehaviour to Other, HingeLike or HardySpicerLike.");
	if (i_rTarget.m_RotationCalibrationBehaviour == TTarget::EOther)
		return size == 0
		    || i_rReport.Fail(
		        "Incorrect rotation target orientation size. Expected 0. Actual " + std::to_string(size), remedy(0));
	// The blank at the end is part of the message.
	return size == 3
	    || i_rReport.Fail(
	        "Incorrect rotation target orientation size. Expected 3. Actual " + std::to_string(size) + " ", remedy(3));
}

template <typename TTarget>
bool CheckViewNormals(const TTarget& i_rTarget, const VReport& i_rReport)
{
	constexpr const char* c_pMessage = "Invalid target view normals";
	const std::size_t markerCount = i_rTarget.m_MarkerIndices.size();
	if (i_rTarget.m_ViewNormals.size() != markerCount)
		return i_rReport.Fail(c_pMessage,
		    "Give ViewNormals " + Count(markerCount, "entry", "entries") + ", one for each marker; it has "
		        + std::to_string(i_rTarget.m_ViewNormals.size()) + ".");
	for (const auto& [x, y, z] : i_rTarget.m_ViewNormals)
	{
		const double length = std::sqrt(x * x + y * y + z * z);
		if (!(length == 0.0 || std::abs(length - 1.0) <= 1e-6))
			return i_rReport.Fail(c_pMessage, "Give each entry of ViewNormals the length 1 or 0.");
	}
	return true;
}

bool CheckType(const VSubject::VTarget& i_rTarget, const VReport& i_rReport)
{
	using VTarget = VSubject::VTarget;
	const VTypeRules* const pRules = FindRules(i_rTarget.m_Type);
	if (!pRules)
		return FailType(i_rReport);
	if (i_rTarget.m_Type == VTarget::EBadTargetType)
		return true;

	const VTypeCheck check(i_rTarget, *pRules, i_rReport);
	const auto markers = [&] { return check.Markers(); };
	const auto rotations = [&] { return check.Rotations(); };
	const auto segments = [&] { return check.Segments(); };
	const auto state = [&] { return check.State(); };
	const auto covariance = [&] { return check.Covariance(); };
	const IFindings& rFindings = i_rReport.Findings();
	if (i_rTarget.m_Type == VTarget::ELocalDirectionToWorldDirection)
		return rFindings.InTurn(segments, state, markers, rotations, covariance, [&] { return check.UnitDirection(); });
	return rFindings.InTurn(markers, rotations, segments, state, covariance,
	    [&]
	    { return i_rTarget.m_Type != VTarget::ELocalRotationToWorldRotation || CheckBehaviour(i_rTarget, i_rReport); });
}

bool CheckIndices(const std::vector<std::uint32_t>& i_rIndices, std::size_t i_Count, const std::string& i_rWhat,
    const char* i_pField, const VReport& i_rReport)
{
	return i_rReport.Findings().ForEach(i_rIndices.size(),
	    [&](std::size_t i)
	    {
		    return i_rIndices[i] < i_Count
		        || i_rReport.Fail("Out of range " + i_rWhat + " index " + std::to_string(i_rIndices[i]),
		            std::string("Correct ") + i_pField + ": the subject has " + Count(i_Count, i_rWhat, i_rWhat + "s")
		                + (i_Count == 0 ? "." : ", counted from 0."));
	    });
}

bool CheckTemplateCovariance(
    const VSubjectParametrised::VTarget& i_rTarget, const VTypeRules& i_rRules, const VReport& i_rReport)
{
	constexpr const char* c_pInvalid = "Invalid target template covariance matrix";
	constexpr const char* c_pField = "TemplateCovariance";
	const std::vector<double>& rValues = i_rTarget.m_TemplateCovariance;
	const std::size_t markerCount = i_rTarget.m_MarkerIndices.size();
	const bool bRigidBody = i_rTarget.m_Type == VSubjectParametrised::VTarget::ERigidBody;
	const std::size_t expected = bRigidBody ? RigidBodyCovarianceSize(markerCount) : i_rRules.m_TemplateCovariance;
	if (rValues.empty() && i_rRules.m_bTemplateMayBeEmpty)
		return true;
	if (rValues.size() != expected)
		return i_rReport.Fail("Incorrect template covariance size, E"
		        + std::string(CoreOrlexTypes::EnumeratorName(i_rTarget.m_Type)) + " type expects size "
		        + (bRigidBody ? "36 + 9*MarkerCount" : std::to_string(expected)),
		    SizeRemedy(c_pField, rValues.size(), expected, i_rRules.m_bTemplateMayBeEmpty, WhatAsks(i_rTarget.m_Type)));
	if (expected == 9)
		return CheckMatrix3(c_pField, rValues.data(), c_pInvalid, i_rReport);
	if (!bRigidBody)
		return true;
	const MatrixValidity::EFault fault =
	    MatrixValidity::FaultAsSemidefinite<6>(std::span<const double, 36>(rValues.data(), 36));
	return i_rReport.Findings().InTurn(
	    [&]
	    {
		    return fault == MatrixValidity::EFault::ENone
		        || i_rReport.Fail(c_pInvalid, MatrixRemedy("the pose's block in TemplateCovariance", fault, false));
	    },
	    [&] { return CheckMarkerBlocks(c_pField, rValues, markerCount, c_pInvalid, i_rReport); });
}

bool CheckCalibration(const VSubjectParametrised::VTarget& i_rTarget, const VReport& i_rReport)
{
	using VTarget = VSubjectParametrised::VTarget;
	const bool bRotation = i_rTarget.m_Type == VTarget::ELocalRotationToWorldRotation;
	if (!bRotation && i_rTarget.m_Type != VTarget::ELocalPointToWorldPoint
	    && i_rTarget.m_Type != VTarget::ELocalPointToWorldPointGaussian)
		return true;
	return i_rReport.Findings().InTurn([&] { return !bRotation || CheckBehaviour(i_rTarget, i_rReport); },
	    [&]
	    {
		    return i_rTarget.m_CalibrationWeight >= 0.0
		        || i_rReport.Fail("Invalid target calibration weight", "Set CalibrationWeight to 0 or more.");
	    });
}

} // namespace

bool CheckTarget(const VSubject& i_rSubject, std::size_t i_TargetIndex, IFindings& io_rFindings)
{
	const VReport report(io_rFindings, VSubjectFinding::ETarget, i_TargetIndex);
	if (i_TargetIndex >= i_rSubject.m_Targets.size())
		return report.Fail("Out-of-range target index " + std::to_string(i_TargetIndex),
		    "The subject has " + Count(i_rSubject.m_Targets.size(), "target", "targets") + ".");
	const VSubject::VTarget& rTarget = i_rSubject.m_Targets[i_TargetIndex];
	return io_rFindings.InTurn([&] { return CheckType(rTarget, report); },
	    [&] {
		    return CheckIndices(
		        rTarget.m_MarkerIndices, i_rSubject.m_Markers.size(), "marker", "MarkerIndices", report);
	    },
	    [&]
	    {
		    return CheckIndices(rTarget.m_RotationObservationIndices, i_rSubject.m_Rotations.size(),
		        "rotation observation", "RotationObservationIndices", report);
	    },
	    [&] {
		    return CheckIndices(
		        rTarget.m_SegmentIndices, i_rSubject.m_Segments.size(), "segment", "SegmentIndices", report);
	    },
	    [&] { return CheckViewNormals(rTarget, report); });
}

bool CheckTargetTemplate(const VSubjectParametrised::VTarget& i_rTarget, const VReport& i_rReport)
{
	return i_rReport.Findings().InTurn([&]
	    { return i_rTarget.m_Weight >= 0.0 || i_rReport.Fail("", "Set Weight to 0 or more."); },
	    [&]
	    {
		    const VTypeRules* const pRules = FindRules(i_rTarget.m_Type);
		    if (!pRules)
			    return FailType(i_rReport);
		    return i_rTarget.m_Type == VSubjectParametrised::VTarget::EBadTargetType
		        || i_rReport.Findings().InTurn([&] { return CheckTemplateCovariance(i_rTarget, *pRules, i_rReport); },
		            [&] { return CheckCalibration(i_rTarget, i_rReport); });
	    },
	    [&] { return CheckViewNormals(i_rTarget, i_rReport); });
}

} // namespace CoreOrlexTypesUtils::SubjectCheck
