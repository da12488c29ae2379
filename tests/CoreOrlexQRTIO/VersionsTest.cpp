#include "Content.h"

#include "CoreOrlexQRTIO/VersionLoss.h"
#include "UtilsRapidXml/Attributes.h"

#include <boost/algorithm/string/join.hpp>
#include <boost/algorithm/string/replace.hpp>

#include <array>
#include <sstream>

namespace CoreOrlexQRTIO
{
namespace
{

using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;
using UtilsRapidXml::VVersion;
using VTexts = std::vector<std::string>;
using VReals = std::vector<double>;
using VTarget = VSubjectParametrised::VTarget;

VTexts AllVersions()
{
	VTexts versions;
	std::istringstream stream(AllVersionTexts());
	for (std::string version; stream >> version;)
		versions.push_back(version);
	return versions;
}

/// One kept file for each version of the format, all of the same subject as far as the version can tell it.
class FrozenFile : public testing::TestWithParam<std::string>
{
protected:
	void SetUp() override
	{
		ASSERT_TRUE(UtilsRapidXml::ToValue(GetParam(), m_Version));
		m_VersionValue = VersionValueFromText(GetParam()).value();
		m_Content = ReadText(DataText("version-" + GetParam() + ".qrs"));
		ASSERT_TRUE(m_Content.m_bRead) << boost::join(m_Content.m_Errors, "\n");
	}

	bool From(std::int32_t i_Major, std::int32_t i_Minor) const { return m_Version >= VVersion{i_Major, i_Minor}; }

	VVersion m_Version;
	std::uint32_t m_VersionValue = 0;
	VContent m_Content;
};

INSTANTIATE_TEST_SUITE_P(Versions, FrozenFile, testing::ValuesIn(AllVersions()),
    [](const auto& i_rInfo) { return "Version" + i_rInfo.param.substr(0, 1) + "_" + i_rInfo.param.substr(2); });

TEST(Versions, AllAreThere)
{
	EXPECT_EQ(AllVersionTexts(), "1.0 1.5 2.0 2.1 2.2 2.3 2.4 2.5 2.6 3.0 3.1 3.2 3.3 3.4 3.5");
	EXPECT_EQ(VersionValueFromText("2.6"), 9u);
	EXPECT_EQ(VersionValueFromText("3.0"), 11u);
	EXPECT_EQ(VersionValueFromText("3.5"), 16u);
	EXPECT_EQ(VersionValueFromText("3.6"), std::nullopt);
	EXPECT_EQ(VersionValueFromText("3"), std::nullopt);
	EXPECT_FALSE(VersionFromValue(10).IsSet());
}

TEST_P(FrozenFile, TellsItsSegments)
{
	const auto& rSegments = m_Content.m_Subject.m_Segments;
	EXPECT_EQ(m_Content.m_Warnings, VTexts());
	ASSERT_EQ(rSegments.size(), 7u);
	const char* const names[] = {"Hips", "Spine", "Shoulder", "Slide", "Tip", "Knee", "Prop"};
	const std::uint32_t parents[] = {0xFFFFFFFFu, 0, 1, 2, 3, 0, 0xFFFFFFFFu};
	const std::uint32_t depths[] = {0, 1, 2, 3, 4, 1, 0};
	for (std::size_t i = 0; i < 7; ++i)
	{
		EXPECT_EQ(rSegments[i].m_Name, names[i]);
		EXPECT_EQ(rSegments[i].m_SegmentIndex, i);
		EXPECT_EQ(rSegments[i].m_ParentSegmentIndex, parents[i]);
		EXPECT_EQ(rSegments[i].m_TreeDepth, depths[i]);
	}
	const bool bNoPose = m_Version == VVersion{1, 5};
	using VTriple = std::array<std::string, 3>;
	const auto& rSpine = rSegments[1];
	EXPECT_EQ(rSpine.m_PreTranslation,
	    bNoPose ? VTriple({"0", "0", "0"}) : VTriple({"0", From(2, 0) ? "20*Scale" : "20", "0"}));
	EXPECT_EQ(rSpine.m_PreRotation, bNoPose ? VTriple({"0", "0", "0"}) : VTriple({"0", "0.25", "0"}));
	EXPECT_EQ(rSpine.m_Bounds[5], "3*Scale");
	EXPECT_EQ(rSpine.m_MassExpression, From(2, 0) ? "0.25*Total" : "");
	EXPECT_EQ(rSpine.m_MassCentreExpressions[2], From(2, 0) ? "10*Scale" : "");
	EXPECT_EQ(rSpine.m_RadiusOfGyrationExpressions[0], From(2, 0) ? "1" : "");

	const VSubjectApplicationData::VSegment& rDisplay = m_Content.m_ApplicationData.m_Segments[1];
	EXPECT_EQ(rDisplay.m_Colour.m_Green, 20);
	EXPECT_EQ(rDisplay.m_Colour.m_Alpha, From(3, 0) ? 200 : 255);
	EXPECT_EQ(rDisplay.m_Visible, !From(3, 0));
	EXPECT_EQ(rDisplay.m_Context, From(2, 0) ? "Left" : "");
	EXPECT_EQ(rDisplay.m_Part, From(3, 0) ? "arm" : "");
	EXPECT_EQ(rDisplay.m_DrawWidth, From(3, 0) ? 2.5 : 0.5);
	EXPECT_EQ(rDisplay.m_DrawStyle,
	    From(3, 0) ? VSubjectApplicationData::VSegment::EDrawStyleSpine
	               : VSubjectApplicationData::VSegment::EDrawStyleBox);
	EXPECT_EQ(rDisplay.m_Joint.m_EulerOrder, VSubjectApplicationData::VJoint::EZYX);
	EXPECT_EQ(rDisplay.m_Joint.m_Labels, "a b c");
	EXPECT_EQ(m_Content.m_Extras.m_Segments[1].m_Size, "old size");
	EXPECT_EQ(m_Content.m_Extras.m_Segments[1].m_Joint.m_Bounds, "bounds SpineJoint");
}

TEST_P(FrozenFile, TellsItsJoints)
{
	const auto& rSegments = m_Content.m_Subject.m_Segments;
	const auto& rShoulder = rSegments[2];
	EXPECT_EQ(rShoulder.m_Joint.m_Mean, VReals({0.25, -0.25}));
	EXPECT_EQ(rShoulder.m_Joint.m_Covariance, VReals({10, 0, 0, 11}));
	EXPECT_EQ(rShoulder.m_Joint.m_TemplateMean, From(2, 0) ? VReals({0.25, 0.25}) : VReals());
	EXPECT_EQ(rShoulder.m_Joint.m_TPoseMean, From(2, 1) ? VReals({0.5, 0.5}) : VReals());
	EXPECT_EQ(rShoulder.m_Joint.m_TPoseCovariance, From(2, 1) ? VReals({4, 0, 0, 4}) : VReals());
	EXPECT_EQ(rShoulder.m_Joint.m_RangeMatrix, From(3, 0) ? VReals({2, 0, 0, 2}) : VReals());
	EXPECT_EQ(rShoulder.m_Joint.m_TemplateRangeCentringState, From(3, 0) ? VReals({0.375, 0.375}) : VReals());
	EXPECT_EQ(rShoulder.m_Joint.m_BindPose, From(3, 5) ? VReals({0.75, 0.75}) : VReals());
	EXPECT_EQ(rSegments[4].m_Joint.m_Mean, VReals());

	// Up to 3.1 the pose of the child is an expression that has to be inverted.
	using VTriple = std::array<double, 3>;
	const VTriple expected = From(3, 2) ? VTriple{-1, -2, -3} : From(2, 0) ? VTriple{-1, -2, -4.5} : VTriple{};
	EXPECT_EQ(rShoulder.m_InversePostTranslation, expected);
	EXPECT_EQ(rSegments[5].m_InversePostRotation[2], From(2, 0) ? -0.5 : 0.0);

	// The way back from the knee to the hips is Y, the axis X: Z to X, X to Y, a third of a turn about the diagonal.
	if (m_Version != VVersion{1, 5})
	{
		for (const double component : rSegments[5].m_Joint.m_JointOrientation)
			EXPECT_NEAR(component, 1.2091995761561452, 1e-15);
	}

	const double none = CoreOrlexTypes::c_NotSet;
	EXPECT_EQ(m_Content.m_Subject.m_TPoseConstraints, VReals({0, 0, 0, none, none, none, 0, none, none, none}));
}

TEST_P(FrozenFile, TellsItsMarkersTargetsAndParameters)
{
	const VSubjectParametrised& rSubject = m_Content.m_Subject;
	EXPECT_EQ(rSubject.m_MarkerSetName, "Full");
	ASSERT_EQ(rSubject.m_Markers.size(), 6u);
	using VMarker = VSubjectParametrised::VMarker;
	EXPECT_EQ(rSubject.m_Markers[1].m_Missing, From(2, 0));
	EXPECT_EQ(rSubject.m_Markers[1].m_Status, From(2, 0) ? VMarker::EOptional : VMarker::ERequired);
	EXPECT_EQ(rSubject.m_Markers[3].m_Status, From(2, 0) ? VMarker::ECalibrationOnly : VMarker::ERequired);
	EXPECT_EQ(rSubject.m_Markers[0].m_ViewAngle, From(2, 6) ? 0.5 : 0.0);
	EXPECT_EQ(m_Content.m_Extras.m_Markers[0].m_Descriptor, From(2, 0) && !From(2, 6) ? "describes HIP1" : "");
	EXPECT_EQ(m_Content.m_ApplicationData.m_Sticks[0].m_ColourB.m_Red, From(3, 0) ? 6 : 9);

	const std::size_t targets = From(3, 5) ? 7 : From(3, 4) ? 6 : From(3, 0) ? 4 : 6;
	ASSERT_EQ(rSubject.m_Targets.size(), targets);
	const VTarget& rPoint = rSubject.m_Targets[0];
	EXPECT_EQ(rPoint.m_Type, VTarget::ELocalPointToWorldPoint);
	EXPECT_EQ(rPoint.m_StateExpressions, VTexts({From(2, 0) ? "1*Scale" : "1", "0", "0"}));
	EXPECT_EQ(rPoint.m_Covariance, VReals({1, 0, 0, 0, 2, 0, 0, 0, 3}));
	EXPECT_EQ(rPoint.m_TemplateCovariance.size(), From(2, 0) ? 9u : 0u);
	EXPECT_EQ(rPoint.m_PlacementCovariance.size(), From(3, 3) ? 9u : 0u);
	EXPECT_EQ(rPoint.m_CalibrationWeight, From(3, 5) ? 0.5 : 1.0);
	EXPECT_EQ(m_Content.m_ApplicationData.m_Targets[0].m_Name, From(3, 0) ? "point" : "HIP1");
	const VTarget& rSecond = rSubject.m_Targets[1];
	EXPECT_EQ(rSecond.m_ViewNormals[0][2], m_Version == VVersion({2, 6}) ? 1.0 : 0.0);
	if (From(3, 0))
	{
		EXPECT_EQ(rSecond.m_Type, VTarget::ELocalPlaneToWorldPointGaussian);
		EXPECT_EQ(rSubject.m_Targets[2].m_StateExpressions, VTexts({"4*Scale", "5", "6", "0", "1", "0"}));
		const VTarget& rBody = rSubject.m_Targets[3];
		EXPECT_EQ(rBody.m_Type, VTarget::ERigidBody);
		EXPECT_EQ(rBody.m_MarkerIndices, std::vector<std::uint32_t>({3, 4, 5}));
		EXPECT_EQ(rBody.m_StateExpressions,
		    VTexts({"1", "2", "3", "0", "0", From(3, 1) ? "0.5" : "0", "10", "0", "0", "0", "10*Scale", "0", "0", "0",
		        "10"}));
		ASSERT_EQ(rBody.m_Covariance.size(), 63u);
		EXPECT_EQ(rBody.m_Covariance[35], From(3, 1) ? 6.0 : 0.0);
		EXPECT_EQ(rBody.m_Covariance[62], 2.0);
	}
	if (From(3, 4))
	{
		const VTarget& rTurn = rSubject.m_Targets[4];
		EXPECT_EQ(rTurn.m_RotationCalibrationBehaviour, From(3, 5) ? VTarget::EHingeLike : VTarget::EOther);
		EXPECT_EQ(rTurn.m_RotationTargetOrientation.size(), From(3, 5) ? 3u : 0u);
		EXPECT_EQ(rTurn.m_Weight, 3.0);
		EXPECT_EQ(m_Content.m_ApplicationData.m_Targets[4].m_Colour.m_Alpha, 64);
	}
	EXPECT_EQ(rSubject.m_Rotations.size(), From(3, 4) ? 2u : 0u);

	EXPECT_EQ(rSubject.m_StaticParameters.size(), From(2, 0) ? 2u : 0u);
	ASSERT_EQ(rSubject.m_DynamicParameters.size(), 1u);
	EXPECT_EQ(rSubject.m_DynamicParameters[0].m_Value, 1.5);
	EXPECT_EQ(rSubject.m_DynamicParameters[0].m_Prior, From(2, 0) ? 1.25 : 0.0);
	EXPECT_EQ(rSubject.m_DynamicParameters[0].m_Visible, From(2, 0));
	EXPECT_EQ(m_Content.m_ApplicationData.m_Skin, From(3, 3) ? "suit" : "");
	EXPECT_EQ(rSubject.m_ModelVersion, From(3, 5) ? "7" : "");
	EXPECT_EQ(m_Content.m_ApplicationData.m_RetargetSourceSubject, From(3, 5) ? "Someone" : "");
	EXPECT_EQ(m_Content.m_Extras.m_DynamicSubspaces.size(), From(3, 5) ? 1u : 0u);
}

TEST_P(FrozenFile, ComesBackEqualAtItsOwnVersion)
{
	const std::string first = WriteText(m_Content, m_VersionValue);
	const VContent again = ReadText(first);
	EXPECT_TRUE(again.m_bRead) << boost::join(again.m_Errors, "\n");
	EXPECT_EQ(again.m_Warnings, c_WrittenFileWarnings);
	ExpectSame(m_Content, again);
	EXPECT_TRUE(WriteText(again, m_VersionValue) == first);
	const auto [losses, refusal] =
	    ListVersionLosses(m_Content.m_Subject, m_Content.m_ApplicationData, m_Content.m_Extras, m_VersionValue);
	EXPECT_EQ(losses, VTexts());
	EXPECT_EQ(refusal, "");
}

/// What a subject of 3.5 becomes at this version can be read again, and is stable from then on.
TEST_P(FrozenFile, TakesASubjectOfTheLatestVersion)
{
	const std::string first = WriteText(ReadText(DataText("version-3.5.qrs")), m_VersionValue);
	const VContent again = ReadText(first);
	EXPECT_TRUE(again.m_bRead) << boost::join(again.m_Errors, "\n");
	EXPECT_EQ(again.m_Warnings, c_WrittenFileWarnings);
	EXPECT_TRUE(WriteText(again, m_VersionValue) == first);
}

/// Without templates of markers a reader holds a marker's own position, and without static parameters only numbers.
TEST(Versions, OldestHoldTheStateOfAMarkersTarget)
{
	const VContent content = ReadText(boost::replace_first_copy(
	    boost::replace_first_copy(DataText("version-2.6.qrs"), "POSITION=\"1 0 0\"", "POSITION=\"Height 0 0\""),
	    "POSITION=\"0 2*Scale 0\"", "POSITION=\"0 2*Height 0\""));
	ASSERT_EQ(content.m_Extras.m_Markers[0].m_Position[0], "Height");
	for (const char* const pVersion : {"1.0", "1.5"})
	{
		const VContent again = ReadText(WriteText(content, VersionValueFromText(pVersion).value()));
		EXPECT_EQ(again.m_Warnings, c_WrittenFileWarnings) << pVersion;
		EXPECT_EQ(again.m_Subject.m_Targets[0].m_StateExpressions, VTexts({"1*Scale", "0", "0"})) << pVersion;
		EXPECT_EQ(again.m_Subject.m_Targets[1].m_StateExpressions, VTexts({"0", "3400", "0"})) << pVersion;
	}
}

/// Of several that share what identifies them, each is compared with the one at its place.
TEST(Versions, NothingIsLostOfElementsThatShareTheirIdentity)
{
	VContent content = ReadText(DataText("version-3.5.qrs"));
	const auto losses = [&]
	{
		return ListVersionLosses(
		    content.m_Subject, content.m_ApplicationData, content.m_Extras, VersionValueFromText("3.5").value())
		    .m_Losses;
	};
	auto& rTargets = content.m_Subject.m_Targets;
	for (int i = 0; i < 20; ++i)
	{
		rTargets.push_back(rTargets[5]);
		rTargets.back().m_Weight = i;
		content.m_ApplicationData.m_Targets.push_back(content.m_ApplicationData.m_Targets[5]);
	}
	EXPECT_EQ(losses(), VTexts());
	content.m_Subject.m_Segments[6].m_Name = "Knee";
	EXPECT_EQ(losses(), VTexts());
}

TEST(Versions, LossesAreCounted)
{
	const VContent content = ReadText(DataText("version-3.5.qrs"));
	const auto losses = [&](const char* i_pVersion)
	{
		return ListVersionLosses(
		    content.m_Subject, content.m_ApplicationData, content.m_Extras, VersionValueFromText(i_pVersion).value())
		    .m_Losses;
	};
	EXPECT_EQ(losses("3.5"), VTexts());
	EXPECT_EQ(losses("3.4"),
	    VTexts({"the model version", "the retarget source template", "the retarget source subject", "6 bind poses",
	        "1 target", "2 calibration weights", "2 calibration behaviours", "1 dynamic subspace"}));
	EXPECT_EQ(losses("2.6"),
	    VTexts({"the model version", "the retarget source template", "the retarget source subject", "the skin",
	        "6 joint ranges", "6 bind poses", "7 segment draw settings", "1 stick colour", "6 targets",
	        "1 target weight", "1 calibration weight", "1 placement covariance", "1 target display setting",
	        "2 rotation observations", "1 dynamic subspace"}));
}

/// Of a file of its own version nothing is lost; then it has one thing more, which that version does not hold.
TEST(Versions, EachFieldThatIsLostIsTold)
{
	using VMarker = VSubjectParametrised::VMarker;
	struct VParts
	{
		explicit VParts(VContent& io_rContent)
		    : m_rSubject(io_rContent.m_Subject), m_rApp(io_rContent.m_ApplicationData)
		{
		}

		VSubjectParametrised& m_rSubject;
		VSubjectApplicationData& m_rApp;
		VSubjectParametrised::VSegment& m_rSegment = m_rSubject.m_Segments.at(2);
		VSubjectParametrised::VJoint& m_rJoint = m_rSegment.m_Joint;
		VMarker& m_rMarker = m_rSubject.m_Markers.front();
		VTarget& m_rTarget = m_rSubject.m_Targets.at(1);
		VSubjectParametrised::VDynamicParameter& m_rParameter = m_rSubject.m_DynamicParameters.at(0);
		VSubjectApplicationData::VSegment& m_rDraw = m_rApp.m_Segments.at(2);
		VSubjectApplicationData::VStick& m_rStick = m_rApp.m_Sticks.at(0);
		VSubjectApplicationData::VTarget& m_rShown = m_rApp.m_Targets.at(1);
	};
	const struct
	{
		const char* m_pVersion;
		const char* m_pLoss;
		std::vector<void (*)(VParts&)> m_Changes;
	} rows[]{
	    {"1.5", "1 pre pose",
	        {[](VParts& r) { r.m_rSegment.m_PreRotation[0] = "1"; },
	            [](VParts& r) { r.m_rSegment.m_PreTranslation[1] = "1"; }}},
	    {"1.5", "1 post pose",
	        {[](VParts& r) { r.m_rSegment.m_InversePostRotation[0] = 1; },
	            [](VParts& r) { r.m_rSegment.m_InversePostTranslation[1] = 1; }}},
	    {"1.0", "1 mass distribution",
	        {[](VParts& r) { r.m_rSegment.m_MassExpression = "1"; },
	            [](VParts& r) { r.m_rSegment.m_MassCentreExpressions[0] = "1"; },
	            [](VParts& r) { r.m_rSegment.m_RadiusOfGyrationExpressions[0] = "1"; }}},
	    {"2.0", "1 T-pose",
	        {[](VParts& r) {
		         r.m_rJoint.m_TPoseMean = {1, 1};
	         },
	            [](VParts& r) {
		            r.m_rJoint.m_TPoseCovariance = {1, 0, 0, 1};
	            }}},
	    {"1.0", "1 joint template",
	        {[](VParts& r) {
		         r.m_rJoint.m_TemplateMean = {1, 1};
	         },
	            [](VParts& r) {
		            r.m_rJoint.m_TemplateCovariance = {1, 0, 0, 1};
	            }}},
	    {"2.6", "1 joint range",
	        {[](VParts& r) {
		         r.m_rJoint.m_RangeCentringState = {1, 1};
	         },
	            [](VParts& r) {
		            r.m_rJoint.m_RangeMatrix = {1, 0, 0, 1};
	            },
	            [](VParts& r) {
		            r.m_rJoint.m_TemplateRangeCentringState = {1, 1};
	            },
	            [](VParts& r) {
		            r.m_rJoint.m_TemplateRangeMatrix = {1, 0, 0, 1};
	            }}},
	    {"3.4", "1 bind pose", {[](VParts& r) {
		     r.m_rJoint.m_BindPose = {1, 1};
	     }}},
	    {"1.0", "1 segment context", {[](VParts& r) { r.m_rDraw.m_Context = "Left"; }}},
	    {"2.6", "1 segment draw setting",
	        {[](VParts& r) { r.m_rDraw.m_Colour.m_Alpha = 3; }, [](VParts& r) { r.m_rDraw.m_Visible = false; },
	            [](VParts& r) { r.m_rDraw.m_Part = "arm"; }, [](VParts& r) { r.m_rDraw.m_DrawEndRatio = 2; },
	            [](VParts& r) { r.m_rDraw.m_DrawHeight = 2; }, [](VParts& r) { r.m_rDraw.m_DrawTwist = 2; },
	            [](VParts& r) { r.m_rDraw.m_DrawWidth = 2; }}},
	    {"1.0", "1 marker status setting",
	        {[](VParts& r) { r.m_rMarker.m_Missing = true; },
	            [](VParts& r) { r.m_rMarker.m_Status = VMarker::EOptional; }}},
	    {"2.5", "1 marker view angle", {[](VParts& r) { r.m_rMarker.m_ViewAngle = 1; }}},
	    {"2.6", "1 stick colour",
	        {[](VParts& r) { r.m_rStick.m_ColourA.m_Red ^= 1; }, [](VParts& r) { r.m_rStick.m_ColourB.m_Red ^= 1; }}},
	    {"2.6", "1 target weight", {[](VParts& r) { r.m_rTarget.m_Weight = 7; }}},
	    {"1.0", "1 target covariance", {[](VParts& r) { r.m_rTarget.m_TemplateCovariance.assign(9, 1); }}},
	    {"3.2", "1 placement covariance", {[](VParts& r) { r.m_rTarget.m_PlacementCovariance.assign(9, 1); }}},
	    {"3.4", "1 calibration weight", {[](VParts& r) { r.m_rTarget.m_CalibrationWeight = 0.25; }}},
	    {"2.6", "1 target display setting",
	        {[](VParts& r) { r.m_rShown.m_Name = "x"; }, [](VParts& r) { r.m_rShown.m_Colour.m_Red ^= 1; },
	            [](VParts& r) { r.m_rShown.m_Visible ^= true; }, [](VParts& r) { r.m_rShown.m_FillGaps ^= 1; }}},
	    {"3.2", "the skin",
	        {[](VParts& r) { r.m_rApp.m_Skin = "suit"; }, [](VParts& r) { r.m_rApp.m_SkinColourA.m_Red ^= 1; },
	            [](VParts& r) { r.m_rApp.m_SkinColourB.m_Red ^= 1; }}},
	    {"1.0", "1 dynamic parameter prior",
	        {[](VParts& r) { r.m_rParameter.m_Prior += 1; }, [](VParts& r) { r.m_rParameter.m_StandardDeviation += 1; },
	            [](VParts& r) { r.m_rParameter.m_Visible ^= true; }}},
	    {"1.0", "1 static parameter",
	        {[](VParts& r) { r.m_rSubject.m_StaticParameters.emplace_back().m_Name = "Unused"; }}},
	};
	for (const auto& rRow : rows)
		for (const auto pChange : rRow.m_Changes)
		{
			VContent content = ReadText(DataText("version-" + std::string(rRow.m_pVersion) + ".qrs"));
			VParts parts(content);
			pChange(parts);
			EXPECT_EQ(ListVersionLosses(content.m_Subject, content.m_ApplicationData, content.m_Extras,
			              VersionValueFromText(rRow.m_pVersion).value())
			              .m_Losses,
			    VTexts({rRow.m_pLoss}))
			    << rRow.m_pVersion << ' ' << rRow.m_pLoss;
		}
}

} // namespace
} // namespace CoreOrlexQRTIO
