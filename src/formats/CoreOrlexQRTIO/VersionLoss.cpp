#include "CoreOrlexQRTIO/VersionLoss.h"

#include "CoreOrlexQRTIO/Reader.h"
#include "CoreOrlexQRTIO/Writer.h"

#include <algorithm>
#include <cmath>
#include <optional>
#include <span>
#include <unordered_map>

namespace CoreOrlexQRTIO
{
namespace
{

using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;

/// A subject with all that a file can hold of it.
struct VContent
{
	VSubjectParametrised m_Subject;
	VSubjectApplicationData m_ApplicationData;
	VSubjectQRTExtras m_Extras;
};

bool IsClose(double i_A, double i_B)
{
	return i_A == i_B || std::abs(i_A - i_B) <= 1e-9 * std::max({std::abs(i_A), std::abs(i_B), 1e-3});
}

bool AreClose(const auto& i_rA, const auto& i_rB)
{
	return std::ranges::equal(i_rA, i_rB, IsClose);
}

/// One thing that an element has, and whether two elements have the same.
template <typename T>
struct VAspect
{
	const char* m_pName;
	bool (*m_pIsSame)(const T&, const T&);
};

struct VWholeSegment
{
	const VSubjectParametrised::VSegment& m_rSegment;
	const VSubjectApplicationData::VSegment& m_rDisplay;
};

using VJoint = VSubjectParametrised::VJoint;

const VAspect<VWholeSegment> c_SegmentAspects[] = {
    {"pre pose",
        [](const VWholeSegment& i_rA, const VWholeSegment& i_rB)
        {
	        return i_rA.m_rSegment.m_PreRotation == i_rB.m_rSegment.m_PreRotation
	            && i_rA.m_rSegment.m_PreTranslation == i_rB.m_rSegment.m_PreTranslation;
        }},
    {"post pose",
        [](const VWholeSegment& i_rA, const VWholeSegment& i_rB)
        {
	        return AreClose(i_rA.m_rSegment.m_InversePostRotation, i_rB.m_rSegment.m_InversePostRotation)
	            && AreClose(i_rA.m_rSegment.m_InversePostTranslation, i_rB.m_rSegment.m_InversePostTranslation);
        }},
    {"segment bound",
        [](const VWholeSegment& i_rA, const VWholeSegment& i_rB)
        { return i_rA.m_rSegment.m_Bounds == i_rB.m_rSegment.m_Bounds; }},
    {"mass distribution",
        [](const VWholeSegment& i_rA, const VWholeSegment& i_rB)
        {
	        return i_rA.m_rSegment.m_MassExpression == i_rB.m_rSegment.m_MassExpression
	            && i_rA.m_rSegment.m_MassCentreExpressions == i_rB.m_rSegment.m_MassCentreExpressions
	            && i_rA.m_rSegment.m_RadiusOfGyrationExpressions == i_rB.m_rSegment.m_RadiusOfGyrationExpressions;
        }},
    {"joint orientation",
        [](const VWholeSegment& i_rA, const VWholeSegment& i_rB)
        { return AreClose(i_rA.m_rSegment.m_Joint.m_JointOrientation, i_rB.m_rSegment.m_Joint.m_JointOrientation); }},
    {"T-pose",
        [](const VWholeSegment& i_rA, const VWholeSegment& i_rB)
        {
	        return i_rA.m_rSegment.m_Joint.m_TPoseMean == i_rB.m_rSegment.m_Joint.m_TPoseMean
	            && i_rA.m_rSegment.m_Joint.m_TPoseCovariance == i_rB.m_rSegment.m_Joint.m_TPoseCovariance;
        }},
    {"joint template",
        [](const VWholeSegment& i_rA, const VWholeSegment& i_rB)
        {
	        return i_rA.m_rSegment.m_Joint.m_TemplateMean == i_rB.m_rSegment.m_Joint.m_TemplateMean
	            && i_rA.m_rSegment.m_Joint.m_TemplateCovariance == i_rB.m_rSegment.m_Joint.m_TemplateCovariance;
        }},
    {"joint range",
        [](const VWholeSegment& i_rA, const VWholeSegment& i_rB)
        {
	        const VJoint& rA = i_rA.m_rSegment.m_Joint;
	        const VJoint& rB = i_rB.m_rSegment.m_Joint;
	        return rA.m_RangeCentringState == rB.m_RangeCentringState && rA.m_RangeMatrix == rB.m_RangeMatrix
	            && rA.m_TemplateRangeCentringState == rB.m_TemplateRangeCentringState
	            && rA.m_TemplateRangeMatrix == rB.m_TemplateRangeMatrix;
        }},
    {"bind pose",
        [](const VWholeSegment& i_rA, const VWholeSegment& i_rB)
        { return i_rA.m_rSegment.m_Joint.m_BindPose == i_rB.m_rSegment.m_Joint.m_BindPose; }},
    {"segment context",
        [](const VWholeSegment& i_rA, const VWholeSegment& i_rB)
        { return i_rA.m_rDisplay.m_Context == i_rB.m_rDisplay.m_Context; }},
    {"segment draw setting",
        [](const VWholeSegment& i_rA, const VWholeSegment& i_rB)
        {
	        const VSubjectApplicationData::VSegment& rA = i_rA.m_rDisplay;
	        const VSubjectApplicationData::VSegment& rB = i_rB.m_rDisplay;
	        return rA.m_Colour == rB.m_Colour && rA.m_Visible == rB.m_Visible && rA.m_Part == rB.m_Part
	            && rA.m_DrawEndRatio == rB.m_DrawEndRatio && rA.m_DrawHeight == rB.m_DrawHeight
	            && rA.m_DrawTwist == rB.m_DrawTwist && rA.m_DrawWidth == rB.m_DrawWidth
	            && rA.m_DrawStyle == rB.m_DrawStyle && rA.m_DrawShading == rB.m_DrawShading;
        }},
};

const VAspect<VSubjectParametrised::VMarker> c_MarkerAspects[] = {
    {"marker status setting",
        [](const VSubjectParametrised::VMarker& i_rA, const VSubjectParametrised::VMarker& i_rB)
        { return i_rA.m_Status == i_rB.m_Status && i_rA.m_Missing == i_rB.m_Missing; }},
    {"marker view angle",
        [](const VSubjectParametrised::VMarker& i_rA, const VSubjectParametrised::VMarker& i_rB)
        { return i_rA.m_ViewAngle == i_rB.m_ViewAngle; }},
};

struct VWholeTarget
{
	const VSubjectParametrised::VTarget& m_rTarget;
	const VSubjectApplicationData::VTarget& m_rDisplay;
};

const VAspect<VWholeTarget> c_TargetAspects[] = {
    {"target state",
        [](const VWholeTarget& i_rA, const VWholeTarget& i_rB)
        { return i_rA.m_rTarget.m_StateExpressions == i_rB.m_rTarget.m_StateExpressions; }},
    {"target weight",
        [](const VWholeTarget& i_rA, const VWholeTarget& i_rB)
        { return i_rA.m_rTarget.m_Weight == i_rB.m_rTarget.m_Weight; }},
    {"calibration weight",
        [](const VWholeTarget& i_rA, const VWholeTarget& i_rB)
        { return i_rA.m_rTarget.m_CalibrationWeight == i_rB.m_rTarget.m_CalibrationWeight; }},
    {"calibration behaviour",
        [](const VWholeTarget& i_rA, const VWholeTarget& i_rB)
        {
	        return i_rA.m_rTarget.m_RotationCalibrationBehaviour == i_rB.m_rTarget.m_RotationCalibrationBehaviour
	            && AreClose(i_rA.m_rTarget.m_RotationTargetOrientation, i_rB.m_rTarget.m_RotationTargetOrientation);
        }},
    {"target covariance",
        [](const VWholeTarget& i_rA, const VWholeTarget& i_rB)
        {
	        return i_rA.m_rTarget.m_Covariance == i_rB.m_rTarget.m_Covariance
	            && i_rA.m_rTarget.m_TemplateCovariance == i_rB.m_rTarget.m_TemplateCovariance;
        }},
    {"placement covariance",
        [](const VWholeTarget& i_rA, const VWholeTarget& i_rB)
        { return i_rA.m_rTarget.m_PlacementCovariance == i_rB.m_rTarget.m_PlacementCovariance; }},
    {"target view normal",
        [](const VWholeTarget& i_rA, const VWholeTarget& i_rB)
        {
	        return std::ranges::equal(i_rA.m_rTarget.m_ViewNormals, i_rB.m_rTarget.m_ViewNormals,
	            [](const auto& i_rNormalA, const auto& i_rNormalB) { return AreClose(i_rNormalA, i_rNormalB); });
        }},
    {"target display setting",
        [](const VWholeTarget& i_rA, const VWholeTarget& i_rB)
        {
	        return i_rA.m_rDisplay.m_Name == i_rB.m_rDisplay.m_Name
	            && i_rA.m_rDisplay.m_Colour == i_rB.m_rDisplay.m_Colour
	            && i_rA.m_rDisplay.m_Visible == i_rB.m_rDisplay.m_Visible
	            && i_rA.m_rDisplay.m_FillGaps == i_rB.m_rDisplay.m_FillGaps
	            && i_rA.m_rDisplay.m_DrawStyle == i_rB.m_rDisplay.m_DrawStyle;
        }},
};

class VLosses
{
public:
	void Add(std::size_t i_Count, const std::string& i_rName)
	{
		if (i_Count > 0)
			m_Texts.push_back(std::to_string(i_Count) + ' ' + i_rName + (i_Count > 1 ? "s" : ""));
	}

	void AddIf(bool i_bLost, const char* i_pName)
	{
		if (i_bLost)
			m_Texts.push_back(i_pName);
	}

	/// Counts for each aspect the pairs that differ in it.
	template <typename T>
	void AddAspects(std::span<const VAspect<T>> i_Aspects, const std::vector<std::pair<T, T>>& i_rPairs)
	{
		for (const VAspect<T>& rAspect : i_Aspects)
			Add(std::ranges::count_if(i_rPairs,
			        [&](const std::pair<T, T>& i_rPair) { return !rAspect.m_pIsSame(i_rPair.first, i_rPair.second); }),
			    rAspect.m_pName);
	}

	std::vector<std::string> m_Texts;
};

/// The whole element at an index, if both lists have it.
template <typename TWhole>
std::optional<TWhole> At(const auto& i_rElements, const auto& i_rDisplays, std::size_t i_Index)
{
	if (i_Index >= i_rElements.size() || i_Index >= i_rDisplays.size())
		return std::nullopt;
	return TWhole{i_rElements[i_Index], i_rDisplays[i_Index]};
}

/// Finds the elements of a list by a key: of several that share it, the first, then the second and so on.
class VIndicesByKey
{
public:
	template <typename T>
	VIndicesByKey(const std::vector<T>& i_rElements, const auto& i_rKey)
	{
		for (std::size_t i = i_rElements.size(); i-- > 0;)
			m_Rest[i_rKey(i_rElements[i])].push_back(i);
	}

	/// Each index once; nothing when all of the key are taken.
	std::optional<std::size_t> Take(const std::string& i_rKey)
	{
		const auto found = m_Rest.find(i_rKey);
		if (found == m_Rest.end() || found->second.empty())
			return std::nullopt;
		const std::size_t index = found->second.back();
		found->second.pop_back();
		return index;
	}

private:
	/// Last first.
	std::unordered_map<std::string, std::vector<std::size_t>> m_Rest;
};

/// What a target ties together, which identifies it in another order of the list.
std::string TiesOf(const VSubjectParametrised& i_rSubject, const VSubjectParametrised::VTarget& i_rTarget)
{
	std::string ties = std::to_string(i_rTarget.m_Type);
	const auto append = [&](const std::vector<std::uint32_t>& i_rIndices, const auto& i_rElements)
	{
		for (const std::uint32_t index : i_rIndices)
			ties += '\n' + (index < i_rElements.size() ? i_rElements[index].m_Name : std::string());
	};
	append(i_rTarget.m_SegmentIndices, i_rSubject.m_Segments);
	append(i_rTarget.m_MarkerIndices, i_rSubject.m_Markers);
	append(i_rTarget.m_RotationObservationIndices, i_rSubject.m_Rotations);
	return ties;
}

void AddSegments(const VContent& i_rBefore, const VContent& i_rAfter, VLosses& io_rLosses)
{
	VIndicesByKey after(i_rAfter.m_Subject.m_Segments, [](const auto& i_rSegment) { return i_rSegment.m_Name; });
	std::vector<std::pair<VWholeSegment, VWholeSegment>> pairs;
	for (std::size_t i = 0; i < i_rBefore.m_Subject.m_Segments.size(); ++i)
	{
		const std::optional<std::size_t> found = after.Take(i_rBefore.m_Subject.m_Segments[i].m_Name);
		if (!found)
			continue;
		const auto a = At<VWholeSegment>(i_rBefore.m_Subject.m_Segments, i_rBefore.m_ApplicationData.m_Segments, i);
		const auto b = At<VWholeSegment>(i_rAfter.m_Subject.m_Segments, i_rAfter.m_ApplicationData.m_Segments, *found);
		if (a && b)
			pairs.emplace_back(*a, *b);
	}
	io_rLosses.AddAspects<VWholeSegment>(c_SegmentAspects, pairs);
}

void AddMarkers(const VContent& i_rBefore, const VContent& i_rAfter, VLosses& io_rLosses)
{
	const auto& rBefore = i_rBefore.m_Subject.m_Markers;
	const auto& rAfter = i_rAfter.m_Subject.m_Markers;
	std::vector<std::pair<VSubjectParametrised::VMarker, VSubjectParametrised::VMarker>> pairs;
	for (std::size_t i = 0; i < std::min(rBefore.size(), rAfter.size()); ++i)
		pairs.emplace_back(rBefore[i], rAfter[i]);
	io_rLosses.AddAspects<VSubjectParametrised::VMarker>(c_MarkerAspects, pairs);

	const auto& rSticks = i_rBefore.m_ApplicationData.m_Sticks;
	const auto& rSticksAfter = i_rAfter.m_ApplicationData.m_Sticks;
	std::size_t colours = 0;
	for (std::size_t i = 0; i < std::min(rSticks.size(), rSticksAfter.size()); ++i)
		colours +=
		    rSticks[i].m_ColourA != rSticksAfter[i].m_ColourA || rSticks[i].m_ColourB != rSticksAfter[i].m_ColourB;
	io_rLosses.Add(colours, "stick colour");
	const auto descriptors = [](const VContent& i_rContent)
	{
		return std::ranges::count_if(i_rContent.m_Extras.m_Markers,
		    [](const VSubjectQRTExtras::VMarker& i_rMarker) { return !i_rMarker.m_Descriptor.empty(); });
	};
	if (descriptors(i_rAfter) < descriptors(i_rBefore))
		io_rLosses.Add(descriptors(i_rBefore) - descriptors(i_rAfter), "marker descriptor");
}

void AddTargets(const VContent& i_rBefore, const VContent& i_rAfter, VLosses& io_rLosses)
{
	const auto& rAfter = i_rAfter.m_Subject.m_Targets;
	VIndicesByKey after(rAfter, [&](const auto& i_rTarget) { return TiesOf(i_rAfter.m_Subject, i_rTarget); });
	std::vector<std::pair<VWholeTarget, VWholeTarget>> pairs;
	std::size_t lost = 0;
	for (std::size_t i = 0; i < i_rBefore.m_Subject.m_Targets.size(); ++i)
	{
		const std::optional<std::size_t> found =
		    after.Take(TiesOf(i_rBefore.m_Subject, i_rBefore.m_Subject.m_Targets[i]));
		if (!found)
		{
			++lost;
			continue;
		}
		const auto a = At<VWholeTarget>(i_rBefore.m_Subject.m_Targets, i_rBefore.m_ApplicationData.m_Targets, i);
		const auto b = At<VWholeTarget>(rAfter, i_rAfter.m_ApplicationData.m_Targets, *found);
		if (a && b)
			pairs.emplace_back(*a, *b);
	}
	io_rLosses.Add(lost, "target");
	io_rLosses.AddAspects<VWholeTarget>(c_TargetAspects, pairs);
	const std::size_t rotations = i_rBefore.m_Subject.m_Rotations.size();
	if (i_rAfter.m_Subject.m_Rotations.size() < rotations)
		io_rLosses.Add(rotations - i_rAfter.m_Subject.m_Rotations.size(), "rotation observation");
}

void AddParameters(const VContent& i_rBefore, const VContent& i_rAfter, VLosses& io_rLosses)
{
	const auto& rStatic = i_rBefore.m_Subject.m_StaticParameters;
	if (i_rAfter.m_Subject.m_StaticParameters.size() < rStatic.size())
		io_rLosses.Add(rStatic.size() - i_rAfter.m_Subject.m_StaticParameters.size(), "static parameter");
	const auto& rDynamic = i_rBefore.m_Subject.m_DynamicParameters;
	const auto& rDynamicAfter = i_rAfter.m_Subject.m_DynamicParameters;
	std::size_t changed = 0;
	for (std::size_t i = 0; i < std::min(rDynamic.size(), rDynamicAfter.size()); ++i)
		changed += rDynamic[i].m_Prior != rDynamicAfter[i].m_Prior
		    || rDynamic[i].m_StandardDeviation != rDynamicAfter[i].m_StandardDeviation
		    || rDynamic[i].m_Visible != rDynamicAfter[i].m_Visible;
	io_rLosses.Add(changed, "dynamic parameter prior");
}

} // namespace

VVersionLosses ListVersionLosses(const VSubjectParametrised& i_rSubject,
    const VSubjectApplicationData& i_rApplicationData, const VSubjectQRTExtras& i_rExtras, std::uint32_t i_VersionValue)
{
	std::string text;
	std::vector<std::string> errors;
	std::vector<std::string> warnings;
	if (!VWriter().WriteText(i_rSubject, i_rApplicationData, i_rExtras, i_VersionValue, text, errors, warnings))
		return {};
	VContent after;
	if (!VReader().ReadText(std::move(text), i_rSubject.m_Name, i_rSubject.m_SubjectId, after.m_Subject,
	        after.m_ApplicationData, after.m_Extras, errors, warnings))
		return {{}, errors.front()};

	VLosses losses;
	const VContent before{i_rSubject, i_rApplicationData, i_rExtras};
	losses.AddIf(i_rSubject.m_ModelVersion != after.m_Subject.m_ModelVersion, "the model version");
	losses.AddIf(i_rApplicationData.m_RetargetSourceTemplate != after.m_ApplicationData.m_RetargetSourceTemplate,
	    "the retarget source template");
	losses.AddIf(i_rApplicationData.m_RetargetSourceSubject != after.m_ApplicationData.m_RetargetSourceSubject,
	    "the retarget source subject");
	losses.AddIf(i_rApplicationData.m_Skin != after.m_ApplicationData.m_Skin
	        || i_rApplicationData.m_SkinColourA != after.m_ApplicationData.m_SkinColourA
	        || i_rApplicationData.m_SkinColourB != after.m_ApplicationData.m_SkinColourB,
	    "the skin");
	AddParameters(before, after, losses);
	AddSegments(before, after, losses);
	AddMarkers(before, after, losses);
	AddTargets(before, after, losses);
	if (after.m_Extras.m_DynamicSubspaces.size() < i_rExtras.m_DynamicSubspaces.size())
		losses.Add(i_rExtras.m_DynamicSubspaces.size() - after.m_Extras.m_DynamicSubspaces.size(), "dynamic subspace");
	return {std::move(losses.m_Texts), {}};
}

} // namespace CoreOrlexQRTIO
