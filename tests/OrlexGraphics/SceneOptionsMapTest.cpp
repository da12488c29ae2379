#include "OrlexGraphics/SceneOptionsMap.h"

#include <QQmlPropertyMap>
#include <gtest/gtest.h>

#include <limits>
#include <map>

namespace
{

using OrlexGraphics::VSceneOptions;
using OrlexGraphics::VSubjectOptions;

const struct
{
	QVariant m_Default;
	QStringList m_Keys;
} c_SceneRows[] = {
    {true,
        {"3D", "GlobalAxis", "FloorGrid", "FloorGridIsTranslucent", "ReconstructionVolume", "Cameras", "CameraFrustums",
            "CameraMaskGrid", "CameraShowRotated", "CameraGreyscale", "CameraCentroids", "Reconstructions",
            "MarkerRadius", "FillMethod", "Locators", "RigidBodies", "FBXScene", "SubjectNames", "Manipulator",
            "HighlightCurrentSubject", "UseCentroidConnectionColourScheme", "Video"}},
    {false,
        {"CameraView", "Distort3D", "YUp", "CameraAxes", "CameraRays", "CameraSnap90Degrees", "CameraMaximiseGreyscale",
            "CameraWandSmear", "CameraBorder", "ReconstructedRadius", "MarkerTrails", "AllowTrailKeySelection",
            "Threshold", "ActiveLabelHalo", "RenderInClipColor", "SelectedReconCount"}},
    {QString(), {"OverlayCamera", "SubjectPreset"}},
    {0, {"ContributionsType", "DebugVideo"}},
    {10, {"trialLengthPast", "trialLengthFuture"}},
    {128, {"CameraMaximiseGreyscaleHistory"}},
    {0x202020u, {"BackgroundColorRGB"}},
    {0.0, {"CameraMaximiseGreyscaleFactor"}},
    {1.0, {"3DOpacity"}},
    {1.0f, {"ReconstructionScale", "ManipulatorScale"}},
    {6.0f, {"FloorGridSize"}},
};

const struct
{
	const char* m_pKey;
	bool m_bDefault;
	bool VSubjectOptions::*m_pMember;
} c_SubjectRows[] = {
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

const std::pair<const char*, VSubjectOptions VSceneOptions::*> c_Classes[] = {
    {"PropSubject-", &VSceneOptions::m_PropSubject}, {"LabellingSubject-", &VSceneOptions::m_LabellingSubject},
    {"SolvingSubject-", &VSceneOptions::m_SolvingSubject},
    {"RetargetingSubject-", &VSceneOptions::m_RetargetingSubject}};

/// Of every key.
std::map<QString, QVariant> Defaults()
{
	std::map<QString, QVariant> defaults;
	for (const auto& rRow : c_SceneRows)
		for (const QString& rKey : rRow.m_Keys)
			defaults[rKey] = rRow.m_Default;
	for (const auto& rClass : c_Classes)
		for (const auto& rRow : c_SubjectRows)
			defaults[QString(rClass.first) + rRow.m_pKey] = rRow.m_bDefault;
	return defaults;
}

std::map<QString, QVariant> Written(const VSceneOptions& i_rOptions)
{
	QQmlPropertyMap map;
	OrlexGraphics::WriteOptionsToMap(i_rOptions, map);
	std::map<QString, QVariant> values;
	for (const QString& rKey : map.keys())
		values[rKey] = map.value(rKey);
	return values;
}

/// What is read where one value is another than the default.
VSceneOptions ReadWith(const QString& i_rKey, const QVariant& i_rValue)
{
	QQmlPropertyMap map;
	OrlexGraphics::WriteOptionsToMap(VSceneOptions(), map);
	map.insert(i_rKey, i_rValue);
	VSceneOptions read;
	EXPECT_TRUE(OrlexGraphics::ReadOptionsFromMap(map, read)) << i_rKey.toStdString();
	return read;
}

TEST(SceneOptionsMap, CarriesEachOptionAloneInItsTypeInBothDirections)
{
	const std::map<QString, QVariant> defaults = Defaults();
	EXPECT_EQ(defaults.size(), 51u + 4u * 14u);
	EXPECT_EQ(Written(VSceneOptions()), defaults);
	for (const auto& [rKey, rDefault] : defaults)
	{
		// As QML writes it: a number is a double.
		const QVariant other = rDefault.type() == QVariant::Bool ? QVariant(!rDefault.toBool())
		    : rDefault.type() == QVariant::String                ? QVariant(QString::fromUtf8("K\xc3\xa4mera"))
		    : rDefault.type() == QVariant::UInt                  ? QVariant(double(0xff102030))
		                                                         : QVariant(rDefault.toDouble() + 3.0);
		std::map<QString, QVariant> expected = defaults;
		expected[rKey] = other;
		EXPECT_TRUE(expected[rKey].convert(rDefault.userType()));
		std::map<QString, QVariant> written = Written(ReadWith(rKey, other));
		EXPECT_EQ(written, expected) << rKey.toStdString();
		for (const auto& [rWritten, rValue] : written)
			EXPECT_EQ(rValue.userType(), defaults.at(rWritten).userType()) << rWritten.toStdString();
	}
}

TEST(SceneOptionsMap, ReadsWhatIsDrawnByUnderItsKey)
{
	const std::pair<const char*, bool VSceneOptions::*> rows[] = {{"3D", &VSceneOptions::m_b3D},
	    {"CameraView", &VSceneOptions::m_bCameraView}, {"Distort3D", &VSceneOptions::m_bDistort3D},
	    {"FBXScene", &VSceneOptions::m_bFBXScene}, {"FloorGrid", &VSceneOptions::m_bFloorGrid},
	    {"FloorGridIsTranslucent", &VSceneOptions::m_bFloorGridIsTranslucent},
	    {"GlobalAxis", &VSceneOptions::m_bGlobalAxis}, {"Manipulator", &VSceneOptions::m_bManipulator},
	    {"Reconstructions", &VSceneOptions::m_bReconstructions},
	    {"ReconstructionVolume", &VSceneOptions::m_bReconstructionVolume}, {"YUp", &VSceneOptions::m_bYUp}};
	for (const auto& [pKey, pMember] : rows)
		EXPECT_NE(ReadWith(pKey, !(VSceneOptions().*pMember)).*pMember, VSceneOptions().*pMember) << pKey;
	for (const auto& [pClass, pSubject] : c_Classes)
		for (const auto& rRow : c_SubjectRows)
			EXPECT_NE(
			    (ReadWith(QString(pClass) + rRow.m_pKey, !rRow.m_bDefault).*pSubject).*rRow.m_pMember, rRow.m_bDefault)
			    << pClass << rRow.m_pKey;
	EXPECT_EQ(ReadWith("OverlayCamera", "urn:7").m_OverlayCamera, "urn:7");
	EXPECT_EQ(ReadWith("ReconstructionScale", 2.5).m_ReconstructionScale, 2.5f);
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
