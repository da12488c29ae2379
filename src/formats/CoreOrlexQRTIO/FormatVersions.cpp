#include "CoreOrlexQRTIO/FormatVersions.h"

#include <algorithm>

namespace CoreOrlexQRTIO
{
namespace
{

using UtilsRapidXml::VVersion;
using VTarget = CoreOrlexTypes::VSubjectParametrised::VTarget;

struct VVersionValue
{
	std::uint32_t m_Value;
	VVersion m_Version;
};

constexpr VVersionValue c_Versions[] = {{0, {1, 0}}, {1, {1, 5}}, {3, {2, 0}}, {4, {2, 1}}, {5, {2, 2}}, {6, {2, 3}},
    {7, {2, 4}}, {8, {2, 5}}, {9, {2, 6}}, {11, {3, 0}}, {12, {3, 1}}, {13, {3, 2}}, {14, {3, 3}}, {15, {3, 4}},
    {16, {3, 5}}};

} // namespace

VVersion VersionFromValue(std::uint32_t i_Value)
{
	const auto* const pFound = std::ranges::find(c_Versions, i_Value, &VVersionValue::m_Value);
	return pFound == std::ranges::end(c_Versions) ? VVersion() : pFound->m_Version;
}

std::optional<std::uint32_t> VersionValueFromText(std::string_view i_Text)
{
	const auto* const pFound = std::ranges::find_if(
	    c_Versions, [&](const VVersionValue& i_rEntry) { return ToText(i_rEntry.m_Version) == i_Text; });
	if (pFound == std::ranges::end(c_Versions))
		return std::nullopt;
	return pFound->m_Value;
}

std::string AllVersionTexts()
{
	std::string texts;
	for (const VVersionValue& rEntry : c_Versions)
	{
		if (!texts.empty())
			texts += ' ';
		texts += ToText(rEntry.m_Version);
	}
	return texts;
}

std::uint32_t LowestVersionValue(const CoreOrlexTypes::VSubjectParametrised& i_rSubject,
    const CoreOrlexTypes::VSubjectApplicationData& i_rApplicationData, const VSubjectQRTExtras& i_rExtras)
{
	if (!i_rSubject.m_ModelVersion.empty() || !i_rApplicationData.m_RetargetSourceTemplate.empty()
	    || !i_rApplicationData.m_RetargetSourceSubject.empty() || !i_rExtras.m_DynamicSubspaces.empty()
	    || std::ranges::any_of(
	        i_rSubject.m_Segments, [](const auto& i_rSegment) { return !i_rSegment.m_Joint.m_BindPose.empty(); })
	    || std::ranges::any_of(i_rSubject.m_Targets,
	        [](const VTarget& i_rTarget)
	        {
		        return i_rTarget.m_Type == VTarget::ELocalDirectionToWorldDirection
		            || i_rTarget.m_CalibrationWeight != 1.0
		            || i_rTarget.m_RotationCalibrationBehaviour != VTarget::EOther
		            || !i_rTarget.m_RotationTargetOrientation.empty();
	        }))
		return 16;
	if (!i_rSubject.m_Rotations.empty())
		return 15;
	if (!i_rApplicationData.m_Skin.empty()
	    || std::ranges::any_of(
	        i_rSubject.m_Targets, [](const VTarget& i_rTarget) { return !i_rTarget.m_PlacementCovariance.empty(); }))
		return 14;
	return 13;
}

} // namespace CoreOrlexQRTIO
