#include "Content.h"

#include <map>

namespace CoreOrlexQRTIO
{
namespace
{

using VTexts = std::vector<std::string>;

/// A whole document of one segment "Root" and one marker "M", in which some sections are replaced.
std::string Document(const std::map<std::string, std::string>& i_rReplaced)
{
	const auto section = [&](const std::string& i_rName, const std::string& i_rDefault)
	{
		const auto found = i_rReplaced.find(i_rName);
		return found == i_rReplaced.end() ? i_rDefault : found->second;
	};
	return "<KinematicModel " + section("attributes", "VERSION='3.5'") + ">" + section("Parameters", "") + "<Skeleton>"
	    + section("Segments", "<Segment NAME='Root'><JointFree NAME='RootJoint'/></Segment>")
	    + "</Skeleton><MarkerSet><Markers>" + section("Markers", "<Marker NAME='M'/>") + "</Markers>"
	    + section("Sticks", "") + "</MarkerSet>" + section("Targets", "") + section("Rest", "") + "</KinematicModel>";
}

std::string Segments(const std::string& i_rText)
{
	return Document({{"Segments", i_rText}});
}

std::string Joint(const std::string& i_rText)
{
	return Segments("<Segment NAME='Root'>" + i_rText + "</Segment>");
}

std::string OldMarkers(const std::string& i_rText)
{
	return Document({{"attributes", "VERSION='2.6'"}, {"Markers", i_rText}});
}

std::string Targets(const std::string& i_rText)
{
	return Document({{"Targets", "<TargetSet><Targets>" + i_rText + "</Targets></TargetSet>"}});
}

std::string Point(const std::string& i_rAttributes)
{
	return Targets("<TargetLocalPointToWorldPoint " + i_rAttributes
	    + "><TargetLocalPointToWorldPointTemplate/></TargetLocalPointToWorldPoint>");
}

std::string Turn(const std::string& i_rAttributes)
{
	return Targets("<TargetLocalRotationToWorldRotation NAME='t' HIDDEN='false' SEGMENT='Root' WEIGHT='1' "
	               "ROTATION-OBSERVATION='o' "
	    + i_rAttributes + "/>");
}

std::string Subspace(const std::string& i_rText)
{
	return Document({{"Rest", "<SubjectDynamicSubspace>" + i_rText + "</SubjectDynamicSubspace>"}});
}

std::string Component(const std::string& i_rAttributes)
{
	return Subspace("<PcaControlledParams NAME='limb' VERSION='1' JOINT-NAMES='RootJoint' "
	                "JOINT-PARAMS-MEAN='0 0 0 0 0 0'><PrincipalComponent NAME='c' JOINT-PARAMS='0 0 0 0 0 0' "
	    + i_rAttributes + "/></PcaControlledParams>");
}

struct VMessageRow
{
	const char* m_pName;
	std::string m_Text;
	VTexts m_Errors;
	VTexts m_Warnings = {};
	std::uint32_t m_Id = c_TestId;
};

void PrintTo(const VMessageRow& i_rRow, std::ostream* o_pStream)
{
	*o_pStream << i_rRow.m_Text;
}

const VTexts c_None;

const std::vector<VMessageRow> c_MessageRows{
    // The document.
    {"Fine", Document({}), c_None},
    {"Empty", "", {"File has no KinematicModel element"}},
    {"NotXml", "hello", {"Failed to read file"}, {"line 1: text outside of any element"}},
    {"WrongRoot", "<Model/>", {"File has no KinematicModel element"}, {"Ignoring unrecognised element type: //Model"}},
    {"TwoRoots", Document({}) + Document({}), {"File has more than one KinematicModel element"},
        {"Ignoring unrecognised element type: //KinematicModel/Skeleton",
            "Ignoring unrecognised element type: //KinematicModel/MarkerSet",
            "Ignoring unrecognised attribute: //KinematicModel/VERSION"}},
    {"NoSections", "<KinematicModel VERSION='3.5'/>",
        {"//KinematicModel element must have a minimum of 1 Skeleton child elements",
            "//KinematicModel element must have a minimum of 1 MarkerSet child elements"}},
    {"TooNew", "<KinematicModel VERSION='3.6'><Skeleton/></KinematicModel>",
        {"Cannot load QRT file with version 3.6, maximum supported version is 3.5"},
        {"Ignoring unrecognised element type: //KinematicModel/Skeleton"}},
    {"TooOld", "<KinematicModel VERSION='0.9'/>",
        {"Cannot load QRT file with version 0.9, minimum supported version is 1.0"}},
    {"VersionIsNoVersion", Document({{"attributes", "VERSION='three'"}}),
        {"KinematicModel node's VERSION attribute could not be interpreted"}},
    {"Development", "<KinematicModel VERSION='3.5' DEVELOPMENT='true'><Skeleton/></KinematicModel>",
        {"Attempting to load a QRT version which was saved while in development."},
        {"Ignoring unrecognised element type: //KinematicModel/Skeleton"}},
    {"NotInDevelopment", Document({{"attributes", "VERSION='3.5' DEVELOPMENT='false'"}}), c_None},
    {"UnknownThings", Document({{"attributes", "VERSION='3.5' NEW='1'"}, {"Rest", "<New/>"}}), c_None,
        {"Ignoring unrecognised element type: //KinematicModel/New",
            "Ignoring unrecognised attribute: //KinematicModel/NEW"}},
    {"SectionTooNew", Document({{"attributes", "VERSION='3.2'"}, {"Rest", "<Skin NAME='s'/>"}}), c_None,
        {"Ignoring //KinematicModel/Skin element. Not supported in files with version 3.2"}},
    {"AttributeTooNew", Document({{"attributes", "VERSION='3.4' MODEL-VERSION='1'"}}), c_None,
        {"Ignoring MODEL-VERSION attribute in KinematicModel element. Not supported in files with version 3.4"}},
    {"SectionTwice", Document({{"Rest", "<Skin/><Skin/>"}}),
        {"//KinematicModel element must have a maximum of 1 Skin child elements"}},
    // Parameters.
    {"ParameterWithoutName", Document({{"Parameters", "<Parameters><Parameter VALUE='1'/></Parameters>"}}),
        {"Parameter element missing required attribute NAME"}},
    {"ParameterWithoutNumber", Document({{"Parameters", "<Parameters><Parameter NAME='p' VALUE='1,5'/></Parameters>"}}),
        {"Parameter node's VALUE attribute could not be interpreted"}},
    {"NumberOverflows", Document({{"Parameters", "<Parameters><Parameter NAME='p' VALUE='1e999'/></Parameters>"}}),
        {"Parameter node's VALUE attribute could not be interpreted"}},
    {"NotANumber", Document({{"Parameters", "<Parameters><Parameter NAME='p' VALUE='nan'/></Parameters>"}}),
        {"Parameter node's VALUE attribute could not be interpreted"}},
    {"NumberUnderflows", Document({{"Parameters", "<Parameters><Parameter NAME='p' VALUE='1e-400'/></Parameters>"}}),
        c_None},
    {"BoolOtherwiseSpelt",
        Document({{"Parameters", "<Parameters><Parameter NAME='p' VALUE='1' HIDDEN='True'/></Parameters>"}}),
        {"Parameter node's HIDDEN attribute could not be interpreted"}},
    {"QuantityUnknown",
        Document({{"Parameters", "<Parameters><StaticParameter NAME='p' QUANTITY='metres'/></Parameters>"}}),
        {"StaticParameter node's QUANTITY attribute could not be interpreted"}},
    {"StaticParameterTwice",
        Document({{"Parameters", "<Parameters><StaticParameter NAME='p'/><StaticParameter NAME='p'/></Parameters>"}}),
        {"Error parsing subject static parameter expressions",
            "Cannot add StaticParameter 'p', a StaticParameter with that name already exists.",
            "Failed validating one or more Expressions"},
        {"File contains duplicate ID : p "}},
    {"StaticParameterForward",
        Document({{"Parameters", "<Parameters><StaticParameter NAME='p' EXPRESSION='q'/></Parameters>"}}),
        {"Error parsing subject static parameter expressions",
            "Validation of StaticParameter 'p' expression 'q' failed, Parse Error at column 2: ID \"q\" was referenced "
            "but never declared.",
            "Failed validating one or more Expressions"}},
    // Segments and joints.
    {"SegmentWithoutName", Segments("<Segment><JointDummy/></Segment>"),
        {"Segment element missing required attribute NAME"}},
    {"SegmentWithoutJoint", Joint(""),
        {"//KinematicModel/Skeleton/Segment element must have a one of the following child elements: JointBall "
         "JointDummy JointFree JointHardySpicer JointHinge JointSlider"}},
    {"SegmentWithTwoJoints", Joint("<JointFree/><JointBall/>"),
        {"//KinematicModel/Skeleton/Segment element cannot have both a JointBall and a JointFree child element"}},
    {"SegmentNamedTwice",
        Segments("<Segment NAME='Root'><JointDummy/></Segment><Segment NAME='Root'><JointDummy/></Segment>"), c_None,
        {"File contains duplicate ID : Root "}},
    {"MarkerNamedLikeItsSegment", Document({{"Markers", "<Marker NAME='Root'/>"}}), c_None,
        {"File contains duplicate ID : Root "}},
    {"DroppedSegmentTakesItsChildren",
        Segments("<Segment NAME='Root' HIDDEN='yes'><JointDummy/><Segment NAME='Child'><JointDummy X='1'/></Segment>"
                 "</Segment>"),
        {"Segment node's HIDDEN attribute could not be interpreted"},
        {"Ignoring unrecognised attribute: //KinematicModel/Skeleton/Segment/Segment/JointDummy/X"}},
    {"ColourOfTwo", Segments("<Segment NAME='Root' RGB='1 2'><JointDummy/></Segment>"),
        {"Segment node's RGB attribute had incorrect number of components"}},
    {"ColourNegative", Segments("<Segment NAME='Root' RGB='1 2 -3'><JointDummy/></Segment>"),
        {"Segment node's RGB attribute could not be interpreted"}},
    {"BoundsOfFive", Segments("<Segment NAME='Root' BOUNDS='1 2 3 4 5'><JointDummy/></Segment>"),
        {"Segment node's BOUNDS attribute had incorrect number of components"}},
    {"DrawStyleUnknown", Segments("<Segment NAME='Root' DRAW-STYLE='ball'><JointDummy/></Segment>"),
        {"Segment node's DRAW-STYLE attribute could not be interpreted"}},
    {"BoundsDoNotParse", Segments("<Segment NAME='Root' BOUNDS='0 0 0 0 0 (1'><JointDummy/></Segment>"),
        {"Parse Error at column 3: Unbalanced parentheses", "Failed validating one or more Expressions"},
        {"Segment 'Root' has the invalid expression '(1'"}},
    {"MassWithoutParameter", Segments("<Segment NAME='Root' MASS='m'><JointDummy/></Segment>"),
        {"Parse Error at column 2: ID \"m\" was referenced but never declared",
            "Failed validating one or more Expressions"},
        {"Segment 'Root' has the invalid expression 'm'"}},
    {"PostDoesNotParse",
        Document({{"attributes", "VERSION='3.1'"},
            {"Segments", "<Segment NAME='Root'><JointDummy POST-POSITION='0 0 p'/></Segment>"}}),
        {"Parse Error at column 2: ID \"p\" was referenced but never declared",
            "Failed validating one or more Expressions"},
        {"Segment 'Root' has the invalid expression 'p'"}},
    {"PostInNewFile", Joint("<JointDummy POST-POSITION='0 0 1'/>"), c_None,
        {"Ignoring POST-POSITION attribute in JointDummy element. Not supported in files with version 3.5"}},
    {"DummyWithMean", Joint("<JointDummy MEAN='1'/>"), c_None,
        {"Ignoring unrecognised attribute: //KinematicModel/Skeleton/Segment/JointDummy/MEAN"}},
    {"MeanOfTwo", Joint("<JointBall MEAN='1 2'/>"),
        {"JointBall node's MEAN attribute had incorrect number of components"}},
    {"PlaceholderInMean", Joint("<JointBall MEAN='1 2 *'/>"),
        {"JointBall node's MEAN attribute could not be interpreted"}},
    {"PlaceholderInT", Joint("<JointBall T='? 2 *'/>"), c_None},
    {"EulerOrderUnknown", Joint("<JointBall EULER-ORDER='XYX'/>"),
        {"JointBall node's EULER-ORDER attribute could not be interpreted"}},
    {"HardySpicerWithoutAxes", Joint("<JointHardySpicer NAME='j'/>"), c_None,
        {"Hardy-Spicer joint 'j' is missing AXIS-PAIR, using defaults"}},
    {"HardySpicerWithFive", Joint("<JointHardySpicer NAME='j' AXIS-PAIR='1 0 0 0 1'/>"),
        {"Hardy-Spicer joint 'j' has invalid AXIS-PAIR, expected 6 elements got 5"}},
    {"HardySpicerSkew", Joint("<JointHardySpicer NAME='j' AXIS-PAIR='1 0 0 0.002 1 0'/>"),
        {"Hardy-Spicer joint 'j' has non orthogonal axes"}},
    {"HardySpicerNearlyOrthogonal", Joint("<JointHardySpicer NAME='j' AXIS-PAIR='1 0 0 0.0005 1 0'/>"), c_None},
    {"HardySpicerZero", Joint("<JointHardySpicer NAME='j' AXIS-PAIR='1 0 0 0 0 0'/>"),
        {"Hardy-Spicer joint 'j' has an AXIS-PAIR with an axis of length 0"}},
    {"HingeWithoutAxis", Joint("<JointHinge NAME='j'/>"), c_None, {"Hinge joint 'j' is missing AXIS, using default"}},
    {"HingeWithTwo", Joint("<JointHinge NAME='j' AXIS='1 0'/>"),
        {"Hinge joint 'j' has invalid AXIS, expected 3 elements got 2"}},
    {"HingeZero", Joint("<JointHinge NAME='j' AXIS='0 0 0'/>"), {"Hinge joint 'j' has an AXIS of length 0"}},
    {"SliderWithoutAxis", Joint("<JointSlider NAME='j'/>"), c_None,
        {"Slider joint 'j' is missing AXIS, using default"}},
    {"SliderWithFour", Joint("<JointSlider NAME='j' AXIS='1 0 0 0'/>"),
        {"Slider joint 'j' has invalid AXIS, expected 3 elements got 4"}},
    {"SliderZero", Joint("<JointSlider NAME='j' AXIS='0 0 0'/>"), {"Slider joint 'j' has an AXIS of length 0"}},
    // Markers and sticks.
    {"OldMarkerOnUnknownSegment", OldMarkers("<Marker NAME='M' SEGMENT='Arm'/>"),
        {"Marker M is using unknown segment Arm"}, {"File contains unknown IDREF : Arm "}},
    {"MarkerInNewFileWithSegment", Document({{"Markers", "<Marker NAME='M' SEGMENT='Root'/>"}}), c_None,
        {"Ignoring SEGMENT attribute in Marker element. Not supported in files with version 3.5"}},
    {"MarkerStatusUnknown", Document({{"Markers", "<Marker NAME='M' STATUS='gone'/>"}}),
        {"Marker node's STATUS attribute could not be interpreted"}},
    {"OldMarkerPositionOfTwo", OldMarkers("<Marker NAME='M' SEGMENT='Root' POSITION='1 2'/>"),
        {"Marker node's POSITION attribute had incorrect number of components"}},
    {"OldMarkerStateDoesNotParse", OldMarkers("<Marker NAME='M' SEGMENT='Root' POSITION='1 2 x'/>"), c_None,
        {"Target 'M' has the invalid state expression 'x': Parse Error at column 2: ID \"x\" was referenced but never "
         "declared"}},
    {"MarkersOfOneHash", Document({{"Markers", "<Marker NAME='M'/><Marker NAME='M'/>"}}),
        {"Marker M has encountered an ID hash collision"}, {"File contains duplicate ID : M "}, c_HashedIds},
    {"MarkersOfOneNameCounted", Document({{"Markers", "<Marker NAME='M'/><Marker NAME='M'/>"}}), c_None,
        {"File contains duplicate ID : M "}},
    {"StickToUnknownMarker", Document({{"Sticks", "<Sticks><Stick MARKER1='M' MARKER2='N'/></Sticks>"}}),
        {"Sticks is using unknown marker N"}, {"File contains unknown IDREF : N "}},
    {"StickToItself", Document({{"Sticks", "<Sticks><Stick MARKER1='M' MARKER2='M'/></Sticks>"}}), c_None,
        {"Skipped Stick using marker M for MARKER1 and MARKER2"}},
    {"StickWithoutEnd", Document({{"Sticks", "<Sticks><Stick MARKER1='M'/></Sticks>"}}),
        {"Stick element missing required attribute MARKER2"}},
    // Targets, with the messages in the order of the attributes.
    {"TargetWithNothing", Targets("<TargetLocalPointToWorldPoint/>"),
        {"TargetLocalPointToWorldPoint element missing required attribute HIDDEN",
            "TargetLocalPointToWorldPoint element missing required attribute MARKER",
            "TargetLocalPointToWorldPoint element missing required attribute POSITION",
            "TargetLocalPointToWorldPoint element missing required attribute SEGMENT",
            "TargetLocalPointToWorldPoint element missing required attribute WEIGHT",
            "//KinematicModel/TargetSet/Targets/TargetLocalPointToWorldPoint element must have a minimum of 1 "
            "TargetLocalPointToWorldPointTemplate child elements"}},
    {"TargetOnUnknowns", Point("GAUSSIAN='true' HIDDEN='false' MARKER='N' POSITION='0 0 0' SEGMENT='Arm' WEIGHT='1'"),
        {"Gaussian target did not supply a COVARIANCE", "Target is using unknown marker N",
            "Target is using unknown segment Arm"},
        {"File contains unknown IDREF : N ", "File contains unknown IDREF : Arm "}},
    {"TargetStateDoesNotParse", Point("NAME='p' HIDDEN='false' MARKER='M' POSITION='0 0 x' SEGMENT='Root' WEIGHT='1'"),
        c_None,
        {"Target 'p' has the invalid state expression 'x': Parse Error at column 2: ID \"x\" was referenced but never "
         "declared"}},
    {"TargetStyleUnknown",
        Point("HIDDEN='false' MARKER='M' POSITION='0 0 0' SEGMENT='Root' WEIGHT='1' DRAW-STYLE='error'"),
        {"TargetLocalPointToWorldPoint node's DRAW-STYLE attribute could not be interpreted"}},
    {"RigidBodyOfUnknownMarker",
        Targets("<TargetRigidBody HIDDEN='false' POSITION='0 0 0' SEGMENT='Root'>"
                "<RigidBodyMarker NAME='N' POSITION='0 0 0'/></TargetRigidBody>"),
        {"RigidBodyMarker refers to unknown marker N"}, {"File contains unknown IDREF : N "}},
    {"AxisAndPair", Turn("AXIS='1 0 0' AXIS-PAIR='1 0 0 0 1 0'"),
        {" Target 't' AXIS and AXIS-PAIR are mutually exclusive"}},
    {"PairSkew", Turn("AXIS-PAIR='1 0 0 1 1 0'"), {" Target 't'AXIS-PAIR has non-orthogonal axes"}},
    {"AxisZero", Turn("AXIS='0 0 0'"), {" Target 't' AXIS or AXIS-PAIR has a 0-magnitude vector"}},
    {"PairZero", Turn("AXIS-PAIR='1 0 0 0 0 0'"), {" Target 't' AXIS or AXIS-PAIR has a 0-magnitude vector"}},
    {"AxisOfTwo", Turn("AXIS='1 0'"),
        {"TargetLocalRotationToWorldRotation node's AXIS attribute had incorrect number of components"}},
    {"DirectionNotUnit",
        Targets("<TargetLocalDirectionToWorldDirection HIDDEN='false' SEGMENT='Root' WEIGHT='1' "
                "DIRECTION-OBSERVATION='o' DIRECTION='0 0 1.0006'/>"),
        {"Direction target state has to be a unit vector"}},
    {"DirectionNearlyUnit",
        Targets("<TargetLocalDirectionToWorldDirection HIDDEN='false' SEGMENT='Root' WEIGHT='1' "
                "DIRECTION-OBSERVATION='o' DIRECTION='0 0 1.0004'/>"),
        c_None},
    // Two names with one 32-bit hash, found by a search.
    {"ObservationsOfOneHash",
        Targets("<TargetLocalRotationToWorldRotation HIDDEN='false' SEGMENT='Root' WEIGHT='1' "
                "ROTATION-OBSERVATION='Observation17426'/><TargetLocalRotationToWorldRotation HIDDEN='false' "
                "SEGMENT='Root' "
                "WEIGHT='1' ROTATION-OBSERVATION='Observation53318'/>"),
        {"Rotation observation Observation53318 has encountered an ID hash collision"}, {}, c_HashedIds},
    // Dynamic subspaces.
    {"SubspaceEmpty", Subspace(""),
        {"'SubjectDynamicSubspace' declared but does not contain any valid 'PcaControlledParams' elements"}},
    {"SubspaceOfUnmovableSubject",
        Document({{"Segments", "<Segment NAME='Root'><JointDummy NAME='j'/></Segment>"},
            {"Rest",
                "<SubjectDynamicSubspace><PcaControlledParams NAME='n' VERSION='1' JOINT-NAMES='j' "
                "JOINT-PARAMS-MEAN=''/></SubjectDynamicSubspace>"}}),
        {"'SubjectDynamicSubspace' is not compatible with subject"}},
    {"SubspaceOfUnknownJoint",
        Subspace("<PcaControlledParams NAME='n' VERSION='1' JOINT-NAMES='k' JOINT-PARAMS-MEAN=''/>"),
        {"Undefined joint 'k'",
            "'SubjectDynamicSubspace' declared but does not contain any valid 'PcaControlledParams' elements"}},
    {"SubspaceFine", Component("SQRT-EIGENVALUE='0' LOWER-BOUND='-1' UPPER-BOUND='1' TEMPORAL-DERIVATIVE-SD='0'"),
        c_None},
    {"ComponentOutOfBounds",
        Component("SQRT-EIGENVALUE='-1' LOWER-BOUND='2' UPPER-BOUND='1' TEMPORAL-DERIVATIVE-SD='-1'"),
        {" Non-negative 'SQRT-EIGENVALUE' at 'limb : c' ",
            " 'LOWER-EIGENVALUE' greater than 'UPPER-BOUND' at 'limb : c' ",
            "'TEMPORAL-DERIVATIVE-SD' is negative at 'limb c'",
            "'SubjectDynamicSubspace' declared but does not contain any valid 'PcaControlledParams' elements"}},
};

class ReaderMessage : public testing::TestWithParam<VMessageRow>
{
};

INSTANTIATE_TEST_SUITE_P(
    Reader, ReaderMessage, testing::ValuesIn(c_MessageRows), [](const auto& i_rInfo) { return i_rInfo.param.m_pName; });

TEST_P(ReaderMessage, IsTold)
{
	const VContent content = ReadText(GetParam().m_Text, GetParam().m_Id);
	EXPECT_EQ(content.m_Errors, GetParam().m_Errors);
	EXPECT_EQ(content.m_Warnings, GetParam().m_Warnings);
	EXPECT_EQ(content.m_bRead, GetParam().m_Errors.empty());
}

TEST(Reader, WhatOwnFilesHaveIsADetailWhereThatIsWanted)
{
	for (const auto& [pMarkers, rWarnings] : {std::pair{"<Marker NAME='Root'/>", c_None},
	         {"<Marker NAME='Root'/><Marker NAME='Root'/>", VTexts{"File contains duplicate ID : Root "}}})
	{
		VContent content;
		const std::string text = Document({{"attributes", "VERSION='3.5' xmlns:xsi='u'"}, {"Markers", pMarkers}});
		EXPECT_TRUE(VReader(true).ReadText(text, "s", c_TestId, content.m_Subject, content.m_ApplicationData,
		    content.m_Extras, content.m_Errors, content.m_Warnings));
		EXPECT_EQ(content.m_Warnings, rWarnings) << pMarkers;
	}
}

} // namespace
} // namespace CoreOrlexQRTIO
