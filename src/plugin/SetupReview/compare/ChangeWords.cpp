#include "SetupReview/compare/ChangeWords.h"

#include "CoreOrlexTypes/Fields.h"
#include "CoreOrlexTypes/JointType.h"
#include "RetargetSetupCore/BindPose.h"
#include "RetargetSetupCore/GlobalScale.h"
#include "SetupReview/compare/ValueText.h"
#include "math/NumberText.h"
#include "numerics/Rotation.h"

#include <algorithm>
#include <cmath>
#include <numbers>
#include <span>

namespace SetupReview
{
namespace
{

using CoreOrlexTypes::VSubjectParametrised;
using Rotation::VVector3;
using VJoint = VSubjectParametrised::VJoint;
using VTarget = VSubjectParametrised::VTarget;

/// What a function below sees of a change.
struct VCase
{
	const VExpressions& m_rExpressions;
	std::size_t m_Before;
	std::size_t m_After;
	VSetupChange& m_rChange;

	const VSubjectParametrised& Before() const { return m_rExpressions.m_rBefore.m_Record.m_SubjectParametrised; }
	const VSubjectParametrised& After() const { return m_rExpressions.m_rAfter.m_Record.m_SubjectParametrised; }
	const VJoint& JointBefore() const { return Before().m_Segments[m_Before].m_Joint; }
	const VJoint& JointAfter() const { return After().m_Segments[m_After].m_Joint; }
};

std::string Millimetres(double i_Value)
{
	return FixedText(i_Value, i_Value < 0.01 ? 5 : i_Value < 1.0 ? 3 : 1) + " mm";
}

std::string Degrees(double i_Value)
{
	return FixedText(i_Value, i_Value < 0.01 ? 5 : i_Value < 1.0 ? 3 : 1) + " degrees";
}

double Distance(const VVector3& i_rA, const VVector3& i_rB)
{
	return std::hypot(i_rA[0] - i_rB[0], i_rA[1] - i_rB[1], i_rA[2] - i_rB[2]);
}

double DegreesBetween(const VVector3& i_rA, const VVector3& i_rB)
{
	return RetargetSetup::AngleBetween(
	           Rotation::RotationMatrixFromAngleAxis(i_rA), Rotation::RotationMatrixFromAngleAxis(i_rB))
	    * 180.0 / std::numbers::pi;
}

/// Three expressions as numbers; nothing if one has no value.
std::optional<VVector3> Evaluated(
    const CoreOrlexTypesUtils::VDynamicExpressionParserSimple& i_rParser, std::span<const std::string> i_Expressions)
{
	VVector3 values{};
	std::string error;
	if (i_Expressions.size() != values.size())
		return std::nullopt;
	for (std::size_t i = 0; i < values.size(); ++i)
		if (!i_rParser.Evaluate(i_Expressions[i], values[i], error) || !std::isfinite(values[i]))
			return std::nullopt;
	return values;
}

/// Both values of three expressions; nothing, with the change told as any other, if one has none.
std::optional<std::pair<VVector3, VVector3>> BothEvaluated(
    const VCase& i_rCase, std::span<const std::string> i_Before, std::span<const std::string> i_After)
{
	const auto before = Evaluated(i_rCase.m_rExpressions.m_Before, i_Before);
	const auto after = Evaluated(i_rCase.m_rExpressions.m_After, i_After);
	if (!before || !after)
		return std::nullopt;
	return std::pair(*before, *after);
}

/// Below these only the text of an expression is another one.
constexpr double c_SameMillimetres = 1e-9;
constexpr double c_SameDegrees = 1e-9;

void Told(const VCase& i_rCase, const char* i_pId, const std::string& i_rWhat, const std::string& i_rHow)
{
	i_rCase.m_rChange.m_Id = i_pId;
	i_rCase.m_rChange.m_Words = i_rWhat + (i_rHow.empty() ? " is written otherwise, with the same value" : i_rHow);
}

bool Moved(const VCase& i_rCase, double i_Millimetres, const char* i_pId, const std::string& i_rWhat)
{
	Told(i_rCase, i_pId, i_rWhat,
	    i_Millimetres <= c_SameMillimetres ? std::string() : " moved by " + Millimetres(i_Millimetres));
	i_rCase.m_rChange.m_Millimetres = i_Millimetres;
	return true;
}

bool Turned(const VCase& i_rCase, double i_Degrees, const char* i_pId, const std::string& i_rWhat)
{
	Told(i_rCase, i_pId, i_rWhat, i_Degrees <= c_SameDegrees ? std::string() : " turned by " + Degrees(i_Degrees));
	i_rCase.m_rChange.m_Degrees = i_Degrees;
	return true;
}

bool WeightWords(const VCase& i_rCase)
{
	i_rCase.m_rChange.m_Id = "weight";
	i_rCase.m_rChange.m_Words = "weight " + i_rCase.m_rChange.m_Before + " -> " + i_rCase.m_rChange.m_After;
	return true;
}

bool OffsetWords(const VCase& i_rCase)
{
	const VTarget& rBefore = i_rCase.Before().m_Targets[i_rCase.m_Before];
	const VTarget& rAfter = i_rCase.After().m_Targets[i_rCase.m_After];
	const auto values = BothEvaluated(i_rCase, rBefore.m_StateExpressions, rAfter.m_StateExpressions);
	if (!values)
		return true;
	if (rBefore.m_Type == VTarget::ELocalRotationToWorldRotation)
		return Turned(i_rCase, DegreesBetween(values->first, values->second), "offset", "offset");
	if (rBefore.m_Type == VTarget::ELocalPointToWorldPoint
	    || rBefore.m_Type == VTarget::ELocalPointToWorldPointGaussian)
		return Moved(i_rCase, Distance(values->first, values->second), "offset", "offset");
	return true;
}

bool PlaceWords(const VCase& i_rCase)
{
	const auto values = BothEvaluated(i_rCase, i_rCase.Before().m_Segments[i_rCase.m_Before].m_PreTranslation,
	    i_rCase.After().m_Segments[i_rCase.m_After].m_PreTranslation);
	if (!values)
		return true;
	Moved(i_rCase, Distance(values->first, values->second), "length", "place in its parent");
	const double before = Distance(values->first, {});
	const double after = Distance(values->second, {});
	if (*i_rCase.m_rChange.m_Millimetres > c_SameMillimetres)
		i_rCase.m_rChange.m_Words += ": " + Millimetres(before) + " from it before, " + Millimetres(after) + " now";
	return true;
}

bool RestWords(const VCase& i_rCase)
{
	const auto values = BothEvaluated(i_rCase, i_rCase.Before().m_Segments[i_rCase.m_Before].m_PreRotation,
	    i_rCase.After().m_Segments[i_rCase.m_After].m_PreRotation);
	return !values || Turned(i_rCase, DegreesBetween(values->first, values->second), "pre-rotation", "pre-rotation");
}

bool ParentWords(const VCase& i_rCase)
{
	VSetupChange& rChange = i_rCase.m_rChange;
	rChange.m_Id = "parent";
	rChange.m_Words = "hangs on " + rChange.m_After + ", before on " + rChange.m_Before;
	return true;
}

bool JointTypeWords(const VCase& i_rCase)
{
	VSetupChange& rChange = i_rCase.m_rChange;
	const bool bPruned = i_rCase.JointAfter().m_JointType == VJoint::EDummy;
	const bool bMade = i_rCase.JointBefore().m_JointType == VJoint::EDummy;
	rChange.m_Id = bPruned ? "joint-pruned" : bMade ? "joint-made" : "joint-type";
	rChange.m_Words = bPruned ? "joint pruned, which was of type " + rChange.m_Before
	    : bMade               ? "joint made, of type " + rChange.m_After
	                          : "joint is of type " + rChange.m_After + ", before of type " + rChange.m_Before;
	return true;
}

/// A pose or a mean, which are states of the joint.
bool StateWords(
    const VCase& i_rCase, const std::vector<double> VJoint::*i_pState, const char* i_pId, const std::string& i_rWhat)
{
	const VJoint::EJointType type = i_rCase.JointAfter().m_JointType;
	const std::vector<double>& rBefore = i_rCase.JointBefore().*i_pState;
	const std::vector<double>& rAfter = i_rCase.JointAfter().*i_pState;
	const std::size_t size = CoreOrlexTypes::StateSize(type);
	if (i_rCase.JointBefore().m_JointType != type || rBefore.size() != size || rAfter.size() != size || size == 0)
		return true;
	const auto three = [](const std::vector<double>& i_rState, std::size_t i_First) {
		return VVector3{i_rState[i_First], i_rState[i_First + 1], i_rState[i_First + 2]};
	};
	if (type == VJoint::ESlider)
		return Moved(i_rCase, std::abs(rAfter[0] - rBefore[0]), i_pId, i_rWhat);
	if (size < 3)
	{
		double radians = 0.0;
		for (std::size_t i = 0; i < size; ++i)
			radians = std::max(radians, std::abs(rAfter[i] - rBefore[i]));
		return Turned(i_rCase, radians * 180.0 / std::numbers::pi, i_pId, i_rWhat);
	}
	const double degrees = DegreesBetween(three(rBefore, 0), three(rAfter, 0));
	if (size < 6)
		return Turned(i_rCase, degrees, i_pId, i_rWhat);
	const double distance = Distance(three(rBefore, 3), three(rAfter, 3));
	Moved(i_rCase, distance, i_pId, i_rWhat);
	if (degrees > c_SameDegrees)
	{
		Turned(i_rCase, degrees, i_pId, i_rWhat);
		if (distance > c_SameMillimetres)
			i_rCase.m_rChange.m_Words += " and moved by " + Millimetres(distance);
	}
	return true;
}

bool PoseFollowedByMean(const VCase& i_rCase)
{
	return i_rCase.JointBefore().m_BindPose == i_rCase.JointBefore().m_Mean
	    && i_rCase.JointAfter().m_BindPose == i_rCase.JointAfter().m_Mean;
}

bool PoseWords(const VCase& i_rCase)
{
	return StateWords(
	    i_rCase, &VJoint::m_BindPose, "pose", PoseFollowedByMean(i_rCase) ? "bind pose and mean" : "bind pose");
}

bool MeanWords(const VCase& i_rCase)
{
	return !PoseFollowedByMean(i_rCase) && StateWords(i_rCase, &VJoint::m_Mean, "mean", "mean");
}

bool ScaleWords(const VCase& i_rCase)
{
	VSetupChange& rChange = i_rCase.m_rChange;
	if (rChange.m_Name != RetargetSetup::c_GlobalScaleName)
		return true;
	rChange.m_Element = "subject";
	rChange.m_Name.clear();
	rChange.m_Id = "scale";
	rChange.m_Words = "scale " + rChange.m_Before + " -> " + rChange.m_After;
	return true;
}

/// The scale is written into both at once.
bool PriorWords(const VCase& i_rCase)
{
	const auto& rBefore = i_rCase.Before().m_DynamicParameters[i_rCase.m_Before];
	const auto& rAfter = i_rCase.After().m_DynamicParameters[i_rCase.m_After];
	return rBefore.m_Prior != rBefore.m_Value || rAfter.m_Prior != rAfter.m_Value;
}

bool FileWords(const VCase& i_rCase, const char* i_pId, const std::string& i_rWhat)
{
	VSetupChange& rChange = i_rCase.m_rChange;
	rChange.m_Id = i_pId;
	rChange.m_Words = i_rWhat + " " + rChange.m_After + ", before " + rChange.m_Before;
	return true;
}

bool CharacterWords(const VCase& i_rCase)
{
	return FileWords(i_rCase, "character-file", "made of the character's file");
}

bool PerformerWords(const VCase& i_rCase)
{
	return FileWords(i_rCase, "source-file", "made for the performer's file");
}

struct VWording
{
	std::string_view m_Element;
	std::string_view m_Field;
	bool (*m_pWords)(const VCase&);
};

constexpr VWording c_Wordings[] = {{"target", "Weight", WeightWords}, {"target", "StateExpressions", OffsetWords},
    {"segment", "ParentSegmentIndex", ParentWords}, {"segment", "PreTranslation", PlaceWords},
    {"segment", "PreRotation", RestWords}, {"segment", "Joint.JointType", JointTypeWords},
    {"segment", "Joint.BindPose", PoseWords}, {"segment", "Joint.Mean", MeanWords},
    {"dynamic parameter", "Value", ScaleWords}, {"dynamic parameter", "Prior", PriorWords},
    {"subject", "Skin", CharacterWords}, {"subject", "RetargetSourceTemplate", PerformerWords}};

/// A statistic that a joint lost with its pruning, or got when it was made.
bool IsOfJointAlone(const VCase& i_rCase, bool i_bPruned)
{
	bool bOfJoint = false;
	CoreOrlexTypes::ForEachField<VJoint>(
	    [&](const auto& i_rField)
	    {
		    if (i_rCase.m_rChange.m_Field == "Joint." + std::string(i_rField.Key) && i_rField.Key != "JointType")
			    bOfJoint = (i_bPruned ? i_rCase.JointAfter() : i_rCase.JointBefore()).*i_rField.pMember
			        == VJoint().*i_rField.pMember;
	    });
	return bOfJoint;
}

} // namespace

VExpressions::VExpressions(const VSetup& i_rBefore, const VSetup& i_rAfter) : m_rBefore(i_rBefore), m_rAfter(i_rAfter)
{
	std::vector<std::string> errors;
	m_Before.Initialise(i_rBefore.m_Record.m_SubjectParametrised, errors);
	m_After.Initialise(i_rAfter.m_Record.m_SubjectParametrised, errors);
	for (const auto& rParameter : i_rBefore.m_Record.m_SubjectParametrised.m_DynamicParameters)
		m_After.SetVariable(rParameter.m_Name, rParameter.m_Value);
}

bool PutInWords(const VExpressions& i_rExpressions, std::size_t i_Before, std::size_t i_After, VSetupChange& io_rChange)
{
	const VCase change{i_rExpressions, i_Before, i_After, io_rChange};
	if (io_rChange.m_Element == "segment" && io_rChange.m_Field.starts_with("Joint.")
	    && i_Before < change.Before().m_Segments.size() && i_After < change.After().m_Segments.size())
	{
		const bool bPruned = change.JointAfter().m_JointType == VJoint::EDummy;
		if (bPruned != (change.JointBefore().m_JointType == VJoint::EDummy) && IsOfJointAlone(change, bPruned))
			return false;
	}
	const auto* const pWording = std::ranges::find_if(c_Wordings,
	    [&](const VWording& i_rWording)
	    { return i_rWording.m_Element == io_rChange.m_Element && i_rWording.m_Field == io_rChange.m_Field; });
	return pWording == std::end(c_Wordings) || pWording->m_pWords(change);
}

} // namespace SetupReview
