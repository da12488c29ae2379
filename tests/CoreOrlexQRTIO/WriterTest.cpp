#include "../UtilsFileSystem/Log.h"
#include "Content.h"

#include "CoreOrlexTypes/JointType.h"
#include "DebugServices/GlobalLog.h"
#include "NVX/Status.h"

#include <cmath>
#include <functional>
#include <limits>

namespace CoreOrlexQRTIO
{
namespace
{

using CoreOrlexTypes::VSubjectParametrised;
using VTexts = std::vector<std::string>;
using VSegment = VSubjectParametrised::VSegment;
using VJoint = VSubjectParametrised::VJoint;
using VTarget = VSubjectParametrised::VTarget;

constexpr double c_NaN = std::numeric_limits<double>::quiet_NaN();

/// A segment "Root" with a free joint, a segment "Arm" with a hinge on it, a marker "M" with a target on "Arm", and a
/// rotation target, with no extras.
VContent MakeContent()
{
	VContent content;
	VSegment segment;
	segment.m_Name = "Root";
	segment.m_Joint.m_JointType = VJoint::EFree;
	segment.m_Joint.m_Mean.assign(6, 0.25);
	segment.m_Joint.m_Covariance = CoreOrlexTypes::DefaultCovariance(VJoint::EFree);
	content.m_Subject.m_Segments.push_back(segment);
	segment = {};
	segment.m_Name = "Arm";
	segment.m_SegmentIndex = 1;
	segment.m_ParentSegmentIndex = 0;
	segment.m_TreeDepth = 1;
	segment.m_PreTranslation = {"1", "2*GlobalScale", "0.1"};
	segment.m_Joint.m_JointType = VJoint::EHinge;
	segment.m_Joint.m_Mean = {0.5};
	segment.m_Joint.m_Covariance = {10};
	segment.m_Joint.m_JointOrientation = {0.1, -0.2, 0.3};
	content.m_Subject.m_Segments.push_back(segment);
	content.m_ApplicationData.m_Segments.resize(2);
	content.m_Subject.m_DynamicParameters.push_back({"GlobalScale", 1.5, 0, 1.5, true});
	content.m_Subject.m_Markers.emplace_back().m_Name = "M";
	content.m_ApplicationData.m_Markers.resize(1);
	VTarget point;
	point.m_Type = VTarget::ELocalPointToWorldPoint;
	point.m_MarkerIndices = {0};
	point.m_SegmentIndices = {1};
	point.m_StateExpressions = {"1", "2", "3"};
	point.m_ViewNormals.emplace_back();
	VTarget turn;
	turn.m_Type = VTarget::ELocalRotationToWorldRotation;
	turn.m_SegmentIndices = {1};
	turn.m_RotationObservationIndices = {0};
	turn.m_StateExpressions = {"0", "0", "0.5"};
	content.m_Subject.m_Targets = {point, turn};
	content.m_Subject.m_Rotations.push_back({"Turn", 0});
	content.m_ApplicationData.m_Targets.resize(2);
	content.m_ApplicationData.m_Targets[0].m_Name = "p";
	content.m_ApplicationData.m_Targets[1].m_Name = "t";
	content.m_Subject.m_Name = "Template";
	content.m_Subject.m_SubjectId = content.m_ApplicationData.m_SubjectId = c_TestId;
	return content;
}

std::string VersionIn(const std::string& i_rText)
{
	const std::size_t from = i_rText.find("VERSION=\"", i_rText.find("<KinematicModel")) + 9;
	return i_rText.substr(from, i_rText.find('"', from) - from);
}

struct VRow
{
	const char* m_pName;
	std::function<void(VContent&)> m_Change;
	VTexts m_Errors;
	VTexts m_Warnings = {};
};

VContent Changed(const std::function<void(VContent&)>& i_rChange)
{
	VContent content = MakeContent();
	i_rChange(content);
	return content;
}

const VRow c_Rows[] = {
    {"Fine", [](VContent&) {}, {}},
    {"NumberNotFinite", [](VContent& c) { c.m_Subject.m_Segments[1].m_Joint.m_Mean[0] = c_NaN; },
        {"Could not stringify JointHinge node's MEAN attribute value."}},
    {"NumberInfinite", [](VContent& c) { c.m_ApplicationData.m_Segments[0].m_DrawTwist = HUGE_VAL; },
        {"Could not stringify Segment node's DRAW-TWIST attribute value."}},
    {"EnumUnknown",
        [](VContent& c) {
	        c.m_ApplicationData.m_Targets[0].m_DrawStyle =
	            CoreOrlexTypes::VSubjectApplicationData::VTarget::EDrawStyle(7);
        },
        {"Could not stringify TargetLocalPointToWorldPoint node's DRAW-STYLE attribute value."}},
    {"RequiredMarkerMissing", [](VContent& c) { c.m_Subject.m_Markers[0].m_Missing = true; },
        {"Could not stringify Marker node's STATUS attribute value."}},
    {"ExpressionWithBlanks", [](VContent& c) { c.m_Subject.m_Segments[1].m_Bounds[0] = "1 + 2"; },
        {"Node Segment attribute value 1 + 2 contains spaces."}},
    {"QuotedNameWithBlanks",
        [](VContent& c)
        {
	        c.m_Subject.m_DynamicParameters[0].m_Name = "Global Scale";
	        c.m_Subject.m_Segments[1].m_PreTranslation = {"'Global Scale'*2", "-'Global Scale'", ""};
        },
        {}},
    {"ExpressionDoesNotEvaluate", [](VContent& c) { c.m_Subject.m_Segments[1].m_PreTranslation[0] = "x"; },
        {"Parse Error at column 2: ID \"x\" was referenced but never declared"}},
    {"ParameterNameWithBlanksAtItsEnds",
        [](VContent& c) {
	        c.m_Subject.m_DynamicParameters.push_back({" b", 0, 0, 1, true});
        },
        {"Parameter ' b' has blanks at the ends of its name."}},
    {"NamesWithBlanksAtTheirEnds",
        [](VContent& c)
        {
	        c.m_Subject.m_Segments[1].m_Name = "\tArm ";
	        c.m_Subject.m_Markers[0].m_Name = " M";
	        c.m_Subject.m_Rotations[0].m_Name = "Turn ";
        },
        {},
        {"Segment '\tArm ' is written as 'Arm': a file holds no blanks at the ends of a name.",
            "Marker ' M' is written as 'M': a file holds no blanks at the ends of a name.",
            "Rotation observation 'Turn ' is written as 'Turn': a file holds no blanks at the ends of a name."}},
    {"NamesThatWouldBecomeOne",
        [](VContent& c)
        {
	        c.m_Subject.m_Segments[1].m_Name = "Root ";
	        c.m_Subject.m_Markers.emplace_back().m_Name = " M";
	        c.m_Subject.m_Rotations.push_back({" Turn", 1});
        },
        {"Segment 'Root' and Segment 'Root ' would have one name in a file, which holds no blanks at the ends of a "
         "name: rename one of them.",
            "Marker 'M' and Marker ' M' would have one name in a file, which holds no blanks at the ends of a name: "
            "rename one of them.",
            "Rotation observation 'Turn' and Rotation observation ' Turn' would have one name in a file, which holds "
            "no blanks at the ends of a name: rename one of them."}},
    {"BlackWithOpacity0",
        [](VContent& c)
        {
	        c.m_ApplicationData.m_Segments[1].m_Colour = CoreOrlexTypes::c_ColourZero;
	        c.m_ApplicationData.m_Targets[0].m_Colour = CoreOrlexTypes::c_ColourZero;
        },
        {},
        {"Black with opacity 0 is no colour that a file can hold: 2 of the subject's colours come back as the default "
         "one."}},
    {"NameWithControlByte", [](VContent& c) { c.m_Subject.m_Segments[1].m_Name = "A\x01"; },
        {"Segment node's NAME attribute has bytes that XML cannot hold.",
            "TargetLocalPointToWorldPoint node's SEGMENT attribute has bytes that XML cannot hold.",
            "TargetLocalRotationToWorldRotation node's SEGMENT attribute has bytes that XML cannot hold."}},
    {"NameNotUtf8", [](VContent& c) { c.m_Subject.m_Markers[0].m_Name = "\xFF"; },
        {"Marker node's NAME attribute has bytes that XML cannot hold.",
            "TargetLocalPointToWorldPoint node's MARKER attribute has bytes that XML cannot hold."}},
    {"GaussianWithoutCovariance",
        [](VContent& c) { c.m_Subject.m_Targets[0].m_Type = VTarget::ELocalPointToWorldPointGaussian; },
        {"Target 'p' is Gaussian and has no covariance."}},
    {"SegmentOutOfRange", [](VContent& c) { c.m_Subject.m_Targets[0].m_SegmentIndices = {2}; },
        {"TargetLocalPointToWorldPoint element refers to segment 2, which does not exist."}},
    {"MarkerOutOfRange", [](VContent& c) { c.m_Subject.m_Targets[0].m_MarkerIndices = {1}; },
        {"TargetLocalPointToWorldPoint element refers to marker 1, which does not exist."}},
    {"ObservationOutOfRange", [](VContent& c) { c.m_Subject.m_Targets[1].m_RotationObservationIndices = {1}; },
        {"Target 't' refers to a rotation observation that does not exist."}},
    {"TargetsWithNothing",
        [](VContent& c)
        {
	        for (VTarget& rTarget : c.m_Subject.m_Targets)
	        {
		        const VTarget::ETargetType type = rTarget.m_Type;
		        rTarget = {};
		        rTarget.m_Type = type;
	        }
        },
        {"Target 'p' has a state of another size than its type needs.", "Target 'p' has no marker.",
            "Target 'p' has no segment.", "Target 't' has a state of another size than its type needs.",
            "Target 't' has no rotation observation.", "Target 't' has no segment."}},
    {"TargetOfNoType", [](VContent& c) { c.m_Subject.m_Targets[0].m_Type = VTarget::EBadTargetType; },
        {"Target 'p' has a type that a file cannot hold."}},
    {"HingeLikeWithoutOrientation",
        [](VContent& c) { c.m_Subject.m_Targets[1].m_RotationCalibrationBehaviour = VTarget::EHingeLike; },
        {"Target 't' has a calibration behaviour and no orientation for it."}},
    {"OrientationWithoutBehaviour",
        [](VContent& c) {
	        c.m_Subject.m_Targets[1].m_RotationTargetOrientation = {1, 2, 3};
        },
        {}, {"Target 't' loses its calibration behaviour: a file has no word for it."}},
    {"JointOfNoType", [](VContent& c) { c.m_Subject.m_Segments[1].m_Joint.m_JointType = VJoint::EBadJointType; },
        {"Segment 'Arm' has a joint of a type that a file cannot hold."}},
    {"RingOfParents", [](VContent& c) { c.m_Subject.m_Segments[1].m_ParentSegmentIndex = 1; },
        {"1 segments cannot be reached from a root: their parents are missing or go round in a ring."}},
    {"StickOutOfRange",
        [](VContent& c) {
	        c.m_ApplicationData.m_Sticks.push_back({0, {}, 5, {}});
        },
        {"Stick element refers to marker 5, which does not exist."}},
    {"ConstraintsOfNoSize",
        [](VContent& c) {
	        c.m_Subject.m_TPoseConstraints = {1, 2, 3};
        },
        {}, {"The 3 T-pose constraints do not fit the 7 degrees of freedom of the joints: none is written."}},
    {"TargetOnSecondOfAName", [](VContent& c) { c.m_Subject.m_Segments[1].m_Name = "Root"; }, {},
        {"TargetLocalPointToWorldPoint element refers to segment 1, but a reader finds segment 0, which has the same "
         "name 'Root'.",
            "TargetLocalRotationToWorldRotation element refers to segment 1, but a reader finds segment 0, which has "
            "the same name 'Root'."}},
    {"SubspaceOfPrunedJoint",
        [](VContent& c) {
	        c.m_Extras.m_DynamicSubspaces.push_back({"limb", "1", {"j"}, {1, 2}, {}});
        },
        {}, {"Dynamic subspace 'limb' does not fit the joints any more: it is not written."}},
    {"LargerThanAnyThatIsRead", [](VContent& c) { c.m_Subject.m_Model.assign(std::size_t(32) << 20, 'x'); },
        {"The file would be larger than the 33554432 bytes that are read at most."}},
    {"ChainTooDeep",
        [](VContent& c)
        {
	        for (std::uint32_t i = 2; i < 509; ++i)
		        c.m_Subject.m_Segments.emplace_back().m_ParentSegmentIndex = i - 1;
        },
        {"A chain of 509 segments is longer than a file can hold, which is 508."}},
};

TEST(Writer, TellsWhatItCannotWrite)
{
	for (const VRow& rRow : c_Rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		const VContent content = Changed(rRow.m_Change);
		std::string text = "before";
		VTexts errors;
		VTexts warnings;
		EXPECT_EQ(VWriter().WriteText(content.m_Subject, content.m_ApplicationData, content.m_Extras,
		              c_AutomaticVersion, text, errors, warnings),
		    rRow.m_Errors.empty());
		EXPECT_EQ(errors, rRow.m_Errors);
		EXPECT_EQ(warnings, rRow.m_Warnings);
		EXPECT_EQ(text.empty(), !errors.empty());
		EXPECT_TRUE(!errors.empty() || ReadText(text).m_bRead) << text;
	}
}

TEST(Writer, LongestChainThatIsWrittenIsRead)
{
	VContent content = MakeContent();
	for (std::uint32_t i = 2; i < 508; ++i)
		content.m_Subject.m_Segments.emplace_back().m_ParentSegmentIndex = i - 1;
	const VContent again = ReadText(WriteText(content));
	EXPECT_TRUE(again.m_bRead);
	EXPECT_EQ(again.m_Subject.m_Segments.size(), 508u);
	EXPECT_EQ(again.m_Subject.m_Segments.back().m_TreeDepth, 507u);
}

/// Without extras only what the hinge's axis cannot tell is lost.
TEST(Writer, SubjectOfTheProgramComesBackEqual)
{
	VContent content = MakeContent();
	content.m_Subject.m_TPoseConstraints = {1, 2, CoreOrlexTypes::c_NotSet, 4, 5, 6, 7};
	content.m_Subject.m_Segments[1].m_Joint.m_JointOrientation = {};
	content.m_ApplicationData.m_Segments[1].m_Joint.m_Labels = "flex";
	content.m_ApplicationData.m_Segments[1].m_Colour = {1, 2, 3, 4};
	const std::string first = WriteText(content);
	VContent again = ReadText(first);
	EXPECT_TRUE(again.m_bRead);
	// The axis alone does not tell the turn about it, which is chosen anew.
	again.m_Subject.m_Segments[1].m_Joint.m_JointOrientation = {};
	EXPECT_TRUE(again.m_Subject == content.m_Subject);
	EXPECT_TRUE(again.m_ApplicationData == content.m_ApplicationData);
	EXPECT_TRUE(WriteText(ReadText(first)) == first);
}

TEST(Writer, ExtrasFollowTheirSegmentsThroughEdits)
{
	VContent content = ReadText(DataText("version-3.5.qrs"));
	auto& rSegments = content.m_Subject.m_Segments;
	ASSERT_EQ(rSegments[5].m_Name, "Knee");
	// The axis of the file is written as long as it yields the orientation, and not longer.
	EXPECT_NE(WriteText(content).find("AXIS=\"3 0 0\""), std::string::npos);
	rSegments[5].m_Joint.m_JointOrientation = {0, 1.5707963267948966, 0};
	const std::string turned = WriteText(content);
	EXPECT_EQ(turned.find("AXIS=\"3 0 0\""), std::string::npos);
	EXPECT_NE(turned.find("AXIS=\"1 0 "), std::string::npos);
	// The knee becomes the first child, so that no record stands at its old place.
	std::swap(rSegments[1], rSegments[5]);
	std::swap(content.m_ApplicationData.m_Segments[1], content.m_ApplicationData.m_Segments[5]);
	rSegments[1].m_ParentSegmentIndex = 0;
	rSegments[2].m_ParentSegmentIndex = 5;
	const VContent again = ReadText(WriteText(content));
	ASSERT_TRUE(again.m_bRead);
	EXPECT_EQ(again.m_Extras.m_Segments[1].m_Name, "Knee");
	EXPECT_EQ(again.m_Extras.m_Segments[1].m_Joint.m_Signs, "+");
	EXPECT_EQ(again.m_Extras.m_Segments[2].m_Joint.m_Bounds, "bounds SpineJoint");
}

TEST(Writer, AutomaticVersionIsTheLowestThatHoldsTheSubject)
{
	const struct
	{
		const char* m_pVersion;
		bool m_bRotationTarget;
		std::function<void(VContent&)> m_Change;
	} rows[] = {
	    {"3.2", false, [](VContent&) {}},
	    {"3.3", false, [](VContent& c) { c.m_ApplicationData.m_Skin = "suit"; }},
	    {"3.3", false, [](VContent& c) { c.m_Subject.m_Targets[0].m_PlacementCovariance.assign(9, 1); }},
	    {"3.4", true, [](VContent&) {}},
	    {"3.5", true, [](VContent& c) { c.m_Subject.m_Segments[1].m_Joint.m_BindPose = {1}; }},
	    {"3.5", true, [](VContent& c) { c.m_Subject.m_ModelVersion = "1"; }},
	    {"3.5", true, [](VContent& c) { c.m_ApplicationData.m_RetargetSourceTemplate = "performer"; }},
	    {"3.5", true, [](VContent& c) { c.m_ApplicationData.m_RetargetSourceSubject = "Someone"; }},
	    {"3.5", true, [](VContent& c) { c.m_Subject.m_Targets[0].m_CalibrationWeight = 0.5; }},
	    {"3.5", true,
	        [](VContent& c)
	        {
		        c.m_Subject.m_Targets[1].m_RotationCalibrationBehaviour = VTarget::EHingeLike;
		        c.m_Subject.m_Targets[1].m_RotationTargetOrientation.assign(3, 0);
	        }},
	    {"3.5", true,
	        [](VContent& c)
	        {
		        c.m_Subject.m_Targets[1].m_Type = VTarget::ELocalDirectionToWorldDirection;
		        c.m_Subject.m_Targets[1].m_StateExpressions[2] = "1";
	        }},
	};
	for (const auto& rRow : rows)
	{
		VContent content = Changed(rRow.m_Change);
		if (!rRow.m_bRotationTarget)
		{
			content.m_Subject.m_Targets.pop_back();
			content.m_Subject.m_Rotations.clear();
		}
		EXPECT_EQ(VersionIn(WriteText(content)), rRow.m_pVersion) << &rRow - rows;
	}
	EXPECT_EQ(VersionIn(WriteText(MakeContent(), 99)), "-1.-1");
}

/// A folder that goes with the test.
class WrittenFile : public testing::Test
{
protected:
	std::uint32_t Write(const boost::filesystem::path& i_rPath, const VContent& i_rContent, VTexts* o_pErrors)
	{
		return VWriter().Write(i_rPath, i_rContent.m_Subject, i_rContent.m_ApplicationData, i_rContent.m_Extras,
		    c_AutomaticVersion, o_pErrors);
	}

	const VTestFolder m_Folder;
};

TEST_F(WrittenFile, IsWhatTheWriterSays)
{
	const boost::filesystem::path path = m_Folder / "subject.qrr";
	VTexts errors;
	EXPECT_EQ(Write(path, MakeContent(), &errors), NVX::Status::c_Success);
	EXPECT_EQ(errors, VTexts());
	EXPECT_TRUE(Get(path) == WriteText(MakeContent()));
	VTestLog log("QRTIO");
	for (const auto& [bDetails, pLevel] : {std::pair{false, "3 "}, std::pair{true, "6 "}})
	{
		VContent content;
		EXPECT_TRUE(VReader(bDetails).Read(
		    path, "Template", c_TestId, content.m_Subject, content.m_ApplicationData, content.m_Extras));
		EXPECT_EQ(log.Take(), VTexts({pLevel + c_WrittenFileWarnings[0], pLevel + c_WrittenFileWarnings[1]}));
	}
}

TEST_F(WrittenFile, StaysWhenTheSubjectCannotBeWritten)
{
	const boost::filesystem::path path = m_Folder / "subject.qrr";
	Put(path, "before");
	VContent broken = MakeContent();
	broken.m_Subject.m_Segments[1].m_Joint.m_Mean[0] = c_NaN;
	std::vector<std::pair<int, std::string>> logged;
	const auto pSink = NVX::GlobalLog::AddSink(
	    [&](const NVX::VLogCategory& i_rCategory, int i_Level, const std::string& i_rText)
	    {
		    if (i_rCategory.Name() == "QRTIO")
			    logged.emplace_back(i_Level, i_rText);
	    });
	EXPECT_EQ(Write(path, broken, nullptr), NVX::Status::c_WriteFailure);
	EXPECT_EQ(
	    logged, (decltype(logged){{NVX::ELogError, "Could not stringify JointHinge node's MEAN attribute value."}}));
	EXPECT_EQ(Get(path), "before");
	EXPECT_EQ(m_Folder.Count(), 1);
}

TEST_F(WrittenFile, CannotBeAFolderOrStandInNone)
{
	for (const boost::filesystem::path& rPath : {m_Folder.Path(), m_Folder / "none/subject.qrr"})
	{
		VTexts errors;
		EXPECT_EQ(Write(rPath, MakeContent(), &errors), NVX::Status::c_WriteFailure);
		ASSERT_FALSE(errors.empty());
		EXPECT_EQ(errors[0], "Error opening file '" + rPath.string() + "' for writing");
	}
}

} // namespace
} // namespace CoreOrlexQRTIO
