#include "OrlexGraphics/item/SceneOptionsMap.h"

#include <QQmlPropertyMap>
#include <gtest/gtest.h>

#include <functional>
#include <limits>
#include <set>

namespace
{

using OrlexGraphics::VSceneOptions;
using OrlexGraphics::VSubjectOptions;

struct VRow
{
	const char* m_pKey;
	QVariant m_Default;
	/// Another value, as QML would write it.
	QVariant m_Other;
	/// Sets the member that belongs to the key to the other value.
	std::function<void(VSceneOptions&)> m_SetOther;
};

VRow Bool(const char* i_pKey, bool i_bDefault, bool VSceneOptions::*i_pMember)
{
	return {i_pKey, i_bDefault, !i_bDefault, [=](VSceneOptions& o_rOptions) { o_rOptions.*i_pMember = !i_bDefault; }};
}

template <typename T>
VRow Value(const char* i_pKey, T i_Default, T i_Other, T VSceneOptions::*i_pMember)
{
	// A number of QML is a double.
	return {i_pKey, QVariant::fromValue(i_Default), static_cast<double>(i_Other),
	    [=](VSceneOptions& o_rOptions) { o_rOptions.*i_pMember = i_Other; }};
}

VRow Text(const char* i_pKey, std::string VSceneOptions::*i_pMember)
{
	return {i_pKey, QString(), QString::fromUtf8("K\xc3\xa4mera"),
	    [=](VSceneOptions& o_rOptions) { o_rOptions.*i_pMember = "K\xc3\xa4mera"; }};
}

struct VSubjectRow
{
	const char* m_pKey;
	bool m_bDefault;
	bool VSubjectOptions::*m_pMember;
};

const VSubjectRow c_SubjectRows[] = {
    {"Enabled", true, &VSubjectOptions::m_bEnabled},
    {"Axes", false, &VSubjectOptions::m_bAxes},
    {"Bones", true, &VSubjectOptions::m_bBones},
    {"Markers", true, &VSubjectOptions::m_bMarkers},
    {"Sticks", true, &VSubjectOptions::m_bSticks},
    {"Joints", false, &VSubjectOptions::m_bJoints},
    {"MissingMarkers", true, &VSubjectOptions::m_bMissingMarkers},
    {"Origins", true, &VSubjectOptions::m_bOrigins},
    {"SticksDuringGaps", false, &VSubjectOptions::m_bSticksDuringGaps},
    {"Targets", false, &VSubjectOptions::m_bTargets},
    {"TargetCovariances", false, &VSubjectOptions::m_bTargetCovariances},
    {"Clusters", true, &VSubjectOptions::m_bClusters},
    {"Skin", true, &VSubjectOptions::m_bSkin},
    {"SkinXRay", false, &VSubjectOptions::m_bSkinXRay},
};

std::vector<std::pair<QString, VRow>> Rows()
{
	using O = VSceneOptions;
	const VRow rows[] = {
	    Bool("CameraView", false, &O::m_bCameraView),
	    Bool("3D", true, &O::m_b3D),
	    Bool("Distort3D", false, &O::m_bDistort3D),
	    Bool("YUp", false, &O::m_bYUp),
	    Value("3DOpacity", 1.0, 0.25, &O::m_3DOpacity),
	    Text("OverlayCamera", &O::m_OverlayCamera),
	    Bool("GlobalAxis", true, &O::m_bGlobalAxis),
	    Bool("FloorGrid", true, &O::m_bFloorGrid),
	    Bool("FloorGridIsTranslucent", true, &O::m_bFloorGridIsTranslucent),
	    Bool("ReconstructionVolume", true, &O::m_bReconstructionVolume),
	    Value("FloorGridSize", 6.0f, 12.5f, &O::m_FloorGridSize),
	    Bool("Cameras", true, &O::m_bCameras),
	    Bool("CameraAxes", false, &O::m_bCameraAxes),
	    Bool("CameraFrustums", true, &O::m_bCameraFrustums),
	    Bool("CameraRays", false, &O::m_bCameraRays),
	    Bool("CameraMaskGrid", true, &O::m_bCameraMaskGrid),
	    Bool("CameraShowRotated", true, &O::m_bCameraShowRotated),
	    Bool("CameraSnap90Degrees", false, &O::m_bCameraSnap90Degrees),
	    Bool("CameraGreyscale", true, &O::m_bCameraGreyscale),
	    Bool("CameraMaximiseGreyscale", false, &O::m_bCameraMaximiseGreyscale),
	    Value("CameraMaximiseGreyscaleFactor", 0.0, 2.5, &O::m_CameraMaximiseGreyscaleFactor),
	    Value("CameraMaximiseGreyscaleHistory", 128, 7, &O::m_CameraMaximiseGreyscaleHistory),
	    Bool("CameraCentroids", true, &O::m_bCameraCentroids),
	    Bool("CameraWandSmear", false, &O::m_bCameraWandSmear),
	    Bool("CameraBorder", false, &O::m_bCameraBorder),
	    Bool("Reconstructions", true, &O::m_bReconstructions),
	    Bool("ReconstructedRadius", false, &O::m_bReconstructedRadius),
	    Value("ReconstructionScale", 1.0f, 0.5f, &O::m_ReconstructionScale),
	    Value("ContributionsType", 0, 2, &O::m_ContributionsType),
	    Bool("MarkerRadius", true, &O::m_bMarkerRadius),
	    Bool("FillMethod", true, &O::m_bFillMethod),
	    Bool("MarkerTrails", false, &O::m_bMarkerTrails),
	    Bool("AllowTrailKeySelection", false, &O::m_bAllowTrailKeySelection),
	    Value("trialLengthPast", 10, 20, &O::m_TrailLengthPast),
	    Value("trialLengthFuture", 10, 30, &O::m_TrailLengthFuture),
	    Bool("Locators", true, &O::m_bLocators),
	    Bool("RigidBodies", true, &O::m_bRigidBodies),
	    Bool("FBXScene", true, &O::m_bFBXScene),
	    Bool("Threshold", false, &O::m_bThreshold),
	    Bool("ActiveLabelHalo", false, &O::m_bActiveLabelHalo),
	    Bool("SubjectNames", true, &O::m_bSubjectNames),
	    Bool("Manipulator", true, &O::m_bManipulator),
	    Text("SubjectPreset", &O::m_SubjectPreset),
	    Value("BackgroundColorRGB", 0x202020u, 0xff102030u, &O::m_BackgroundColorRGB),
	    Bool("RenderInClipColor", false, &O::m_bRenderInClipColor),
	    Bool("HighlightCurrentSubject", true, &O::m_bHighlightCurrentSubject),
	    Bool("UseCentroidConnectionColourScheme", true, &O::m_bUseCentroidConnectionColourScheme),
	    Value("DebugVideo", 0, 3, &O::m_DebugVideo),
	    Bool("Video", true, &O::m_bVideo),
	    Bool("SelectedReconCount", false, &O::m_bSelectedReconCount),
	    Value("ManipulatorScale", 1.0f, 1.5f, &O::m_ManipulatorScale),
	};
	std::vector<std::pair<QString, VRow>> all;
	for (const VRow& rRow : rows)
		all.emplace_back(rRow.m_pKey, rRow);
	const std::pair<const char*, VSubjectOptions VSceneOptions::*> classes[] = {{"PropSubject", &O::m_PropSubject},
	    {"LabellingSubject", &O::m_LabellingSubject}, {"SolvingSubject", &O::m_SolvingSubject},
	    {"RetargetingSubject", &O::m_RetargetingSubject}};
	for (const auto& [pClass, pMember] : classes)
		for (const VSubjectRow& rRow : c_SubjectRows)
			all.emplace_back(QString("%1-%2").arg(pClass, rRow.m_pKey),
			    VRow{rRow.m_pKey, rRow.m_bDefault, !rRow.m_bDefault,
			        [pMember = pMember, rRow](VSceneOptions& o_rOptions)
			        { o_rOptions.*pMember.*rRow.m_pMember = !rRow.m_bDefault; }});
	return all;
}

TEST(SceneOptionsMap, HasEveryOptionWithItsDefaultInItsType)
{
	QQmlPropertyMap map;
	OrlexGraphics::WriteOptionsToMap(VSceneOptions(), map);
	std::set<QString> keys;
	for (const auto& [rKey, rRow] : Rows())
	{
		keys.insert(rKey);
		EXPECT_EQ(map.value(rKey), rRow.m_Default) << rKey.toStdString();
		EXPECT_EQ(map.value(rKey).userType(), rRow.m_Default.userType()) << rKey.toStdString();
	}
	const QStringList written = map.keys();
	EXPECT_EQ(std::set<QString>(written.begin(), written.end()), keys);
	EXPECT_EQ(keys.size(), 51u + 4u * 14u);
}

TEST(SceneOptionsMap, CarriesEachOptionAloneInBothDirections)
{
	for (const auto& [rKey, rRow] : Rows())
	{
		SCOPED_TRACE(rKey.toStdString());
		VSceneOptions expected;
		rRow.m_SetOther(expected);

		QQmlPropertyMap map;
		OrlexGraphics::WriteOptionsToMap(VSceneOptions(), map);
		map.insert(rKey, rRow.m_Other);
		VSceneOptions read;
		EXPECT_TRUE(OrlexGraphics::ReadOptionsFromMap(map, read));
		EXPECT_TRUE(read == expected);

		QQmlPropertyMap written;
		OrlexGraphics::WriteOptionsToMap(expected, written);
		EXPECT_EQ(written.value(rKey), rRow.m_Other);
		EXPECT_EQ(written.value(rKey).userType(), rRow.m_Default.userType());
	}
}

TEST(SceneOptionsMap, KeepsWhatCannotBeRead)
{
	const QVariant bad[] = {QVariant(), QVariant::fromValue(QList<int>()), std::numeric_limits<double>::quiet_NaN(),
	    std::numeric_limits<double>::infinity()};
	for (const QVariant& rValue : bad)
	{
		QQmlPropertyMap map;
		OrlexGraphics::WriteOptionsToMap(VSceneOptions(), map);
		map.insert("ManipulatorScale", rValue);
		map.insert("SolvingSubject-Axes", true);
		VSceneOptions read;
		read.m_ManipulatorScale = 3.0f;
		EXPECT_FALSE(OrlexGraphics::ReadOptionsFromMap(map, read));
		EXPECT_EQ(read.m_ManipulatorScale, 3.0f);
		EXPECT_TRUE(read.m_SolvingSubject.m_bAxes) << "what can be read is read";
	}
}

} // namespace
