#include "OrlexGraphics/SceneOptionsMap.h"

#include <QQmlPropertyMap>
#include <gtest/gtest.h>

#include <limits>
#include <map>

namespace
{

using OrlexGraphics::VSceneOptions;

const std::pair<QVariant, QStringList> c_SceneRows[] = {
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

/// Of each of the classes.
const std::pair<bool, QStringList> c_SubjectRows[] = {
    {true, {"Enabled", "Bones", "Markers", "Sticks", "MissingMarkers", "Origins", "Clusters", "Skin"}},
    {false, {"Axes", "Joints", "SticksDuringGaps", "Targets", "TargetCovariances", "SkinXRay"}}};

/// Of every key.
std::map<QString, QVariant> Defaults()
{
	std::map<QString, QVariant> defaults;
	for (const auto& [rDefault, rKeys] : c_SceneRows)
		for (const QString& rKey : rKeys)
			defaults[rKey] = rDefault;
	for (const char* const pClass : {"PropSubject-", "LabellingSubject-", "SolvingSubject-", "RetargetingSubject-"})
		for (const auto& [bDefault, rKeys] : c_SubjectRows)
			for (const QString& rKey : rKeys)
				defaults[pClass + rKey] = bDefault;
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

// Those of subjects show in their pictures.
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
