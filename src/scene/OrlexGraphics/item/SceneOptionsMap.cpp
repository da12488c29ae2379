#include "OrlexGraphics/item/SceneOptionsMap.h"

#include <QQmlPropertyMap>
#include <QVariant>

#include <cmath>
#include <type_traits>
#include <variant>

namespace OrlexGraphics
{

namespace
{

template <typename TOptions>
struct VOptionRow
{
	const char* m_pKey;
	std::variant<bool TOptions::*, float TOptions::*, double TOptions::*, std::int32_t TOptions::*,
	    std::uint32_t TOptions::*, std::string TOptions::*, VSubjectOptions TOptions::*>
	    m_Member;
};

constexpr VOptionRow<VSubjectOptions> c_SubjectRows[] = {
    {"Enabled", &VSubjectOptions::m_bEnabled},
    {"Axes", &VSubjectOptions::m_bAxes},
    {"Bones", &VSubjectOptions::m_bBones},
    {"Markers", &VSubjectOptions::m_bMarkers},
    {"Sticks", &VSubjectOptions::m_bSticks},
    {"Joints", &VSubjectOptions::m_bJoints},
    {"MissingMarkers", &VSubjectOptions::m_bMissingMarkers},
    {"Origins", &VSubjectOptions::m_bOrigins},
    {"SticksDuringGaps", &VSubjectOptions::m_bSticksDuringGaps},
    {"Targets", &VSubjectOptions::m_bTargets},
    {"TargetCovariances", &VSubjectOptions::m_bTargetCovariances},
    {"Clusters", &VSubjectOptions::m_bClusters},
    {"Skin", &VSubjectOptions::m_bSkin},
    {"SkinXRay", &VSubjectOptions::m_bSkinXRay},
};

/// The keys are what QML files are written with, odd spellings included.
constexpr VOptionRow<VSceneOptions> c_SceneRows[] = {
    {"CameraView", &VSceneOptions::m_bCameraView},
    {"3D", &VSceneOptions::m_b3D},
    {"Distort3D", &VSceneOptions::m_bDistort3D},
    {"YUp", &VSceneOptions::m_bYUp},
    {"3DOpacity", &VSceneOptions::m_3DOpacity},
    {"OverlayCamera", &VSceneOptions::m_OverlayCamera},
    {"GlobalAxis", &VSceneOptions::m_bGlobalAxis},
    {"FloorGrid", &VSceneOptions::m_bFloorGrid},
    {"FloorGridIsTranslucent", &VSceneOptions::m_bFloorGridIsTranslucent},
    {"ReconstructionVolume", &VSceneOptions::m_bReconstructionVolume},
    {"FloorGridSize", &VSceneOptions::m_FloorGridSize},
    {"Cameras", &VSceneOptions::m_bCameras},
    {"CameraAxes", &VSceneOptions::m_bCameraAxes},
    {"CameraFrustums", &VSceneOptions::m_bCameraFrustums},
    {"CameraRays", &VSceneOptions::m_bCameraRays},
    {"CameraMaskGrid", &VSceneOptions::m_bCameraMaskGrid},
    {"CameraShowRotated", &VSceneOptions::m_bCameraShowRotated},
    {"CameraSnap90Degrees", &VSceneOptions::m_bCameraSnap90Degrees},
    {"CameraGreyscale", &VSceneOptions::m_bCameraGreyscale},
    {"CameraMaximiseGreyscale", &VSceneOptions::m_bCameraMaximiseGreyscale},
    {"CameraMaximiseGreyscaleFactor", &VSceneOptions::m_CameraMaximiseGreyscaleFactor},
    {"CameraMaximiseGreyscaleHistory", &VSceneOptions::m_CameraMaximiseGreyscaleHistory},
    {"CameraCentroids", &VSceneOptions::m_bCameraCentroids},
    {"CameraWandSmear", &VSceneOptions::m_bCameraWandSmear},
    {"CameraBorder", &VSceneOptions::m_bCameraBorder},
    {"Reconstructions", &VSceneOptions::m_bReconstructions},
    {"ReconstructedRadius", &VSceneOptions::m_bReconstructedRadius},
    {"ReconstructionScale", &VSceneOptions::m_ReconstructionScale},
    {"ContributionsType", &VSceneOptions::m_ContributionsType},
    {"MarkerRadius", &VSceneOptions::m_bMarkerRadius},
    {"FillMethod", &VSceneOptions::m_bFillMethod},
    {"MarkerTrails", &VSceneOptions::m_bMarkerTrails},
    {"AllowTrailKeySelection", &VSceneOptions::m_bAllowTrailKeySelection},
    {"trialLengthPast", &VSceneOptions::m_TrailLengthPast},
    {"trialLengthFuture", &VSceneOptions::m_TrailLengthFuture},
    {"Locators", &VSceneOptions::m_bLocators},
    {"RigidBodies", &VSceneOptions::m_bRigidBodies},
    {"FBXScene", &VSceneOptions::m_bFBXScene},
    {"Threshold", &VSceneOptions::m_bThreshold},
    {"ActiveLabelHalo", &VSceneOptions::m_bActiveLabelHalo},
    {"SubjectNames", &VSceneOptions::m_bSubjectNames},
    {"Manipulator", &VSceneOptions::m_bManipulator},
    {"SubjectPreset", &VSceneOptions::m_SubjectPreset},
    {"PropSubject", &VSceneOptions::m_PropSubject},
    {"LabellingSubject", &VSceneOptions::m_LabellingSubject},
    {"SolvingSubject", &VSceneOptions::m_SolvingSubject},
    {"RetargetingSubject", &VSceneOptions::m_RetargetingSubject},
    {"BackgroundColorRGB", &VSceneOptions::m_BackgroundColorRGB},
    {"RenderInClipColor", &VSceneOptions::m_bRenderInClipColor},
    {"HighlightCurrentSubject", &VSceneOptions::m_bHighlightCurrentSubject},
    {"UseCentroidConnectionColourScheme", &VSceneOptions::m_bUseCentroidConnectionColourScheme},
    {"DebugVideo", &VSceneOptions::m_DebugVideo},
    {"Video", &VSceneOptions::m_bVideo},
    {"SelectedReconCount", &VSceneOptions::m_bSelectedReconCount},
    {"ManipulatorScale", &VSceneOptions::m_ManipulatorScale},
};

template <typename T>
QVariant ToVariant(const T& i_rValue)
{
	return QVariant::fromValue(i_rValue);
}

QVariant ToVariant(const std::string& i_rValue)
{
	return QString::fromStdString(i_rValue);
}

template <typename T>
bool FromVariant(QVariant i_Variant, T& o_rValue)
{
	if (!i_Variant.isValid() || !i_Variant.convert(qMetaTypeId<T>()))
		return false;
	const T value = i_Variant.value<T>();
	if constexpr (std::is_floating_point_v<T>)
		if (!std::isfinite(value))
			return false;
	o_rValue = value;
	return true;
}

bool FromVariant(const QVariant& i_rVariant, std::string& o_rValue)
{
	QString text;
	if (!FromVariant(i_rVariant, text))
		return false;
	o_rValue = text.toStdString();
	return true;
}

/// Calls the visitor with key and value of every option of a structure, those of the subject classes under their
/// class.
template <typename TOptions, typename TRows, typename TVisitor>
void ForEachOption(TOptions& io_rOptions, const TRows& i_rRows, const QString& i_rPrefix, TVisitor& i_rVisitor)
{
	for (const auto& rRow : i_rRows)
	{
		const QString key = i_rPrefix + QLatin1String(rRow.m_pKey);
		std::visit(
		    [&](const auto i_pMember)
		    {
			    auto& rValue = io_rOptions.*i_pMember;
			    if constexpr (std::is_same_v<std::remove_cvref_t<decltype(rValue)>, VSubjectOptions>)
				    ForEachOption(rValue, c_SubjectRows, key + QLatin1Char('-'), i_rVisitor);
			    else
				    i_rVisitor(key, rValue);
		    },
		    rRow.m_Member);
	}
}

} // namespace

void WriteOptionsToMap(const VSceneOptions& i_rOptions, QQmlPropertyMap& io_rMap)
{
	const auto write = [&](const QString& i_rKey, const auto& i_rValue)
	{ io_rMap.insert(i_rKey, ToVariant(i_rValue)); };
	ForEachOption(i_rOptions, c_SceneRows, QString(), write);
}

bool ReadOptionsFromMap(const QQmlPropertyMap& i_rMap, VSceneOptions& io_rOptions)
{
	bool bComplete = true;
	const auto read = [&](const QString& i_rKey, auto& o_rValue)
	{ bComplete = FromVariant(i_rMap.value(i_rKey), o_rValue) && bComplete; };
	ForEachOption(io_rOptions, c_SceneRows, QString(), read);
	return bComplete;
}

} // namespace OrlexGraphics
