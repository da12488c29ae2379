#include "CheckedSubject.h"

#include "CoreOrlexTypesUtils/check/SubjectCheck.h"

namespace Parametrised
{

using namespace CoreOrlexTypesUtils;
using VTarget = VSubjectParametrised::VTarget;
using VJoint = VSubjectParametrised::VJoint;

VTarget GoodTarget(VTarget::ETargetType i_Type)
{
	VTarget target;
	target.m_Type = i_Type;
	const bool bRotation =
	    i_Type == VTarget::ELocalRotationToWorldRotation || i_Type == VTarget::ELocalDirectionToWorldDirection;
	target.m_StateExpressions = {"0", "Arm/Arm", ""};
	target.m_SegmentIndices = {1};
	if (bRotation)
		target.m_RotationObservationIndices = {0};
	else if (i_Type == VTarget::ERigidBody)
		target.m_MarkerIndices = {0, 1, 2};
	else
		target.m_MarkerIndices = {0};
	target.m_ViewNormals.resize(target.m_MarkerIndices.size());
	if (i_Type >= VTarget::ELocalPlaneToWorldPoint && i_Type <= VTarget::ERigidBody)
		target.m_StateExpressions.resize(i_Type == VTarget::ERigidBody ? 15 : 6);
	switch (i_Type)
	{
	case VTarget::ELocalPointToWorldPointGaussian: target.m_Covariance = Diagonal(3, 1.0); break;
	case VTarget::ELocalPlaneToWorldPointGaussian: target.m_Covariance = target.m_TemplateCovariance = {1}; break;
	case VTarget::ELocalLineToWorldPointGaussian:
		target.m_Covariance = target.m_TemplateCovariance = Diagonal(2, 1.0);
		break;
	case VTarget::ERigidBody: target.m_Covariance = RigidBodyCovariance(3); break;
	default: break;
	}
	return target;
}

/// A root and a ball joint, three markers, a rotation, one good target of each type, one parameter of each kind.
VSubjectParametrised GoodSubject()
{
	VSubjectParametrised subject;
	subject.m_StaticParameters.resize(1);
	subject.m_StaticParameters[0].m_Name = "Arm";
	subject.m_StaticParameters[0].m_DefaultExpression = "300*cos(0)";
	subject.m_DynamicParameters.push_back({"GlobalScale", 1, 0, 1, false});
	subject.m_Segments.resize(2);
	subject.m_Segments[0].m_Name = "Hips";
	auto& rSegment = subject.m_Segments[1];
	rSegment.m_Name = "Spine";
	rSegment.m_SegmentIndex = 1;
	rSegment.m_ParentSegmentIndex = 0;
	rSegment.m_TreeDepth = 1;
	rSegment.m_PreTranslation = {"2*Arm*GlobalScale", "", "-1"};
	rSegment.m_Joint.m_JointType = VJoint::EBall;
	rSegment.m_Joint.m_Mean.resize(3);
	rSegment.m_Joint.m_Covariance = Diagonal(3, 10.0);
	subject.m_Markers.resize(3);
	for (std::uint32_t i = 0; i < 3; ++i)
	{
		subject.m_Markers[i].m_MarkerId = i;
		subject.m_Markers[i].m_Name = "M" + std::to_string(i);
	}
	subject.m_Rotations.resize(1);
	subject.m_Targets.push_back(VTarget());
	for (int type = 1; type < 10; ++type)
		subject.m_Targets.push_back(GoodTarget(VTarget::ETargetType(type)));
	return subject;
}

/// One line for each finding: kind, index, name, message; and whether it has a remedy.
VTexts Listed(const VSubjectParametrised& i_rSubject)
{
	VTexts lines;
	for (const VSubjectFinding& rFinding : FindSubjectFaults(i_rSubject))
	{
		static constexpr const char* c_Kinds[] = {"parameter", "marker", "segment", "target"};
		lines.push_back(std::string(c_Kinds[rFinding.m_Element]) + " " + std::to_string(rFinding.m_Index) + " "
		    + rFinding.m_Name + (rFinding.m_bTolerated ? "~ " : ": ") + rFinding.m_Message);
		EXPECT_FALSE(rFinding.m_Remedy.empty()) << lines.back();
		EXPECT_EQ(rFinding.m_Remedy.find('\n'), std::string::npos);
	}
	return lines;
}

class SubjectCheckParametrised : public CheckedSubject
{
protected:
	VSubjectParametrised m_Subject = GoodSubject();

	VTexts Messages()
	{
		return Failing([&] { return CheckSubjectParametrised(m_Subject); });
	}
};

TEST_F(SubjectCheckParametrised, GoodSubjectsPassInSilence)
{
	ExpectPasses([&] { return CheckSubjectParametrised({}); });
	ExpectPasses([&] { return CheckSubjectParametrised(m_Subject); });
	VJoint& rJoint = m_Subject.m_Segments[1].m_Joint;
	rJoint.m_BindPose = rJoint.m_TemplateMean = rJoint.m_TemplateRangeCentringState = {1, 2, 3};
	rJoint.m_TemplateCovariance = VNumbers(9, 0.0);
	rJoint.m_TemplateRangeMatrix = Diagonal(3, 4.0);
	m_Subject.m_Targets[VTarget::ELocalPointToWorldPoint].m_TemplateCovariance = Diagonal(3, 1.0);
	m_Subject.m_Targets[VTarget::ERigidBody].m_TemplateCovariance = RigidBodyCovariance(3);
	m_Subject.m_Targets[VTarget::ERigidBody].m_Weight = m_Subject.m_Targets[1].m_CalibrationWeight = 0.0;
	ExpectPasses([&] { return CheckSubjectParametrised(m_Subject); });
	EXPECT_EQ(Listed(m_Subject), VTexts{});
}

TEST_F(SubjectCheckParametrised, TemplatesOfJointsTellEverything)
{
	VJoint joint;
	joint.m_JointType = VJoint::EBall;
	ExpectPasses([&] { return CheckJointTemplate(joint); });
	joint.m_TemplateMean.resize(4);
	joint.m_TemplateCovariance.resize(8);
	joint.m_TemplateRangeCentringState.resize(2);
	joint.m_TemplateRangeMatrix.resize(10);
	joint.m_BindPose.resize(2);
	const auto check = [&] { return CheckJointTemplate(joint); };
	EXPECT_EQ(Failing(check),
	    (VTexts{"Incorrect 'TemplateMean' vector size.", "Incorrect 'TemplateCovariance' size.",
	        "Incorrect 'TemplateRangeCentringState' vector size.", "Incorrect 'TemplateRangeMatrix' size.",
	        "Incorrect 'BindPose' vector size."}));
	joint.m_TemplateMean.clear();
	joint.m_TemplateCovariance = joint.m_TemplateRangeMatrix = Diagonal(3, c_NaN);
	joint.m_TemplateRangeCentringState.clear();
	joint.m_BindPose.resize(3);
	EXPECT_EQ(Failing(check),
	    (VTexts{"Invalid joint template covariance matrix", "Inconsistent template stats information.",
	        "Invalid joint range matrix", "Inconsistent template range information."}));
	m_Subject.m_Segments[1].m_Joint.m_BindPose.resize(4);
	EXPECT_EQ(Messages(), (VTexts{"Incorrect 'BindPose' vector size.", "Segment Spine, invalid template values"}));
}

TEST_F(SubjectCheckParametrised, TemplatesOfTargets)
{
	const std::string size = "Incorrect template covariance size, ";
	const std::string invalid = "Invalid target template covariance matrix";
	const std::string weight = "Invalid target calibration weight";
	const std::string normals = "Invalid target view normals";
	const struct
	{
		int m_Type;
		void (*m_pChange)(VTarget&);
		VTexts m_Messages;
	} rows[] = {
	    {1, [](VTarget& io_r) { io_r.m_Weight = -1e-9; }, {}},
	    {1, [](VTarget& io_r) { io_r.m_Weight = c_NaN; }, {}},
	    {1, [](VTarget& io_r) { io_r.m_Type = VTarget::ETargetType(10); }, {"Unknown target type"}},
	    {1, [](VTarget& io_r) { io_r.m_TemplateCovariance.resize(8); },
	        {size + "ELocalPointToWorldPoint type expects size 9"}},
	    {2, [](VTarget& io_r) { io_r.m_TemplateCovariance.resize(10); },
	        {size + "ELocalPointToWorldPointGaussian type expects size 9"}},
	    {3, [](VTarget& io_r) { io_r.m_TemplateCovariance.resize(1); },
	        {size + "ELocalPlaneToWorldPoint type expects size 0"}},
	    {4, [](VTarget& io_r) { io_r.m_TemplateCovariance.clear(); },
	        {size + "ELocalPlaneToWorldPointGaussian type expects size 1"}},
	    {5, [](VTarget& io_r) { io_r.m_TemplateCovariance.resize(1); },
	        {size + "ELocalLineToWorldPoint type expects size 0"}},
	    {6, [](VTarget& io_r) { io_r.m_TemplateCovariance.clear(); },
	        {size + "ELocalLineToWorldPointGaussian type expects size 4"}},
	    {7, [](VTarget& io_r) { io_r.m_TemplateCovariance.resize(62); },
	        {size + "ERigidBody type expects size 36 + 9*MarkerCount"}},
	    {8, [](VTarget& io_r) { io_r.m_TemplateCovariance.resize(1); },
	        {size + "ELocalRotationToWorldRotation type expects size 0"}},
	    {9, [](VTarget& io_r) { io_r.m_TemplateCovariance.resize(1); },
	        {size + "ELocalDirectionToWorldDirection type expects size 0"}},
	    {1, [](VTarget& io_r) { io_r.m_TemplateCovariance = Diagonal(3, -1.0); }, {invalid}},
	    {2, [](VTarget& io_r) { io_r.m_TemplateCovariance = Diagonal(3, c_NaN); }, {invalid}},
	    {7, [](VTarget& io_r) { (io_r.m_TemplateCovariance = RigidBodyCovariance(3))[35] = -1; }, {invalid}},
	    {7, [](VTarget& io_r) { (io_r.m_TemplateCovariance = RigidBodyCovariance(3))[62] = c_Infinity; }, {invalid}},
	    {1, [](VTarget& io_r) { io_r.m_CalibrationWeight = -1; }, {weight}},
	    {2, [](VTarget& io_r) { io_r.m_CalibrationWeight = c_NaN; }, {weight}},
	    {8, [](VTarget& io_r) { io_r.m_CalibrationWeight = -1; }, {weight}},
	    {3,
	        [](VTarget& io_r)
	        {
		        io_r.m_CalibrationWeight = -1;
		        io_r.m_ViewNormals.clear();
	        },
	        {normals}},
	    {8,
	        [](VTarget& io_r)
	        {
		        io_r.m_RotationCalibrationBehaviour = VTarget::EBadBehaviourType;
		        io_r.m_CalibrationWeight = -1;
	        },
	        {"Invalid rotation calibration behaviour"}},
	    {8, [](VTarget& io_r) { io_r.m_RotationTargetOrientation.resize(1); },
	        {"Incorrect rotation target orientation size. Expected 0. Actual 1"}},
	    {8, [](VTarget& io_r) { io_r.m_RotationCalibrationBehaviour = VTarget::EHardySpicerLike; },
	        {"Incorrect rotation target orientation size. Expected 3. Actual 0 "}},
	    {0, [](VTarget& io_r) { io_r.m_ViewNormals.resize(1); }, {normals}},
	    {9, [](VTarget& io_r) { io_r.m_ViewNormals.resize(1); }, {normals}},
	    {1,
	        [](VTarget& io_r) {
		        io_r.m_ViewNormals[0] = {0, 0, 0.5};
	        },
	        {normals}},
	    // The first finding ends it.
	    {1,
	        [](VTarget& io_r)
	        {
		        io_r.m_TemplateCovariance.resize(1);
		        io_r.m_CalibrationWeight = -1;
		        io_r.m_ViewNormals.clear();
	        },
	        {size + "ELocalPointToWorldPoint type expects size 9"}},
	};
	for (const auto& rRow : rows)
	{
		VTarget target = m_Subject.m_Targets[rRow.m_Type];
		ExpectPasses([&] { return CheckTargetTemplate(target); });
		rRow.m_pChange(target);
		EXPECT_EQ(Failing([&] { return CheckTargetTemplate(target); }), rRow.m_Messages) << "row " << &rRow - rows;
	}
	m_Subject.m_Targets[3].m_Weight = -1;
	EXPECT_EQ(Messages(), VTexts{"Target 3, invalid weights or template values"});
	EXPECT_EQ(Listed(m_Subject), VTexts{"target 3 : Target 3, invalid weights or template values"});
}

TEST_F(SubjectCheckParametrised, ExpressionsOfSegments)
{
	auto& rSegment = m_Subject.m_Segments[1];
	rSegment.m_PreRotation = {"1+1+", " ", "Arm^2"};
	rSegment.m_PreTranslation = {"sin(1)", "Leg", "1)2 3"};
	const VTexts expected{
	    "Segment Spine, Y pre-rotation, invalid expresssion: Parse Error at column 2: Empty expression",
	    "Segment Spine, Z pre-rotation, invalid expresssion: Parse Error at column 6: Power operator invalid for "
	    "arguments",
	    "Segment Spine, X pre-translation, invalid expresssion: Parse Error at column 4: Unknown function \"sin\"",
	    "Segment Spine, Y pre-translation, invalid expresssion: Parse Error at column 4: ID \"Leg\" was referenced but "
	    "never declared",
	    "Segment Spine, Z pre-translation, invalid expresssion: Parse Error at column 3: Unexpected token \")\""};
	VTexts log{"SubjectUtils: Could not evaluate m_PreTranslation expressions in segment 'Spine'",
	    "SubjectUtils: Could not evaluate m_PreRotation expressions in segment 'Spine'"};
	log.insert(log.end(), expected.begin(), expected.end());
	EXPECT_EQ(Messages(), log);
	VTexts listed;
	for (const std::string& rMessage : expected)
		listed.push_back("segment 1 Spine: " + rMessage);
	EXPECT_EQ(Listed(m_Subject), listed);
}

TEST_F(SubjectCheckParametrised, ExpressionsOfTargets)
{
	m_Subject.m_Targets[2].m_StateExpressions[2] = "2*";
	m_Subject.m_Targets[2].m_StateExpressions[1] = "x";
	m_Subject.m_Targets[1].m_StateExpressions[0] = "*";
	EXPECT_EQ(Messages(),
	    (VTexts{"SubjectUtils: Parse Error at column 2: Unexpected token \"*\"",
	        "Target 1, state component 0, invalid expresssion: Parse Error at column 2: Unexpected token \"*\"",
	        "Target 2, state component 1, invalid expresssion: Parse Error at column 2: ID \"x\" was referenced but "
	        "never "
	        "declared"}));
}

TEST_F(SubjectCheckParametrised, StaticParameters)
{
	m_Subject.m_StaticParameters.resize(3);
	m_Subject.m_StaticParameters[1] = m_Subject.m_StaticParameters[0];
	m_Subject.m_StaticParameters[2].m_Name = "Leg";
	m_Subject.m_StaticParameters[2].m_DefaultExpression = "GlobalScale";
	const std::string taken = "Cannot add StaticParameter 'Arm', a StaticParameter with that name already exists.";
	const std::string unknown =
	    "Validation of StaticParameter 'Leg' expression 'GlobalScale' failed, Parse Error at column 12: ID "
	    "\"GlobalScale\" was referenced but never declared.";
	EXPECT_EQ(Messages(),
	    (VTexts{"SubjectUtils: Error parsing subject static parameter expressions", "SubjectUtils: " + taken,
	        "SubjectUtils: " + unknown, "Error parsing Subject static parameter expressions", taken, unknown}));
	EXPECT_EQ(Listed(m_Subject), (VTexts{"parameter 1 Arm: " + taken, "parameter 2 Leg: " + unknown}));
	// Where what an expression uses has failed, so does the expression.
	m_Subject.m_StaticParameters.erase(m_Subject.m_StaticParameters.begin(), m_Subject.m_StaticParameters.begin() + 2);
	m_Subject.m_Segments[1].m_PreTranslation[0] = "Leg";
	m_Subject.m_Targets.clear();
	const std::string segment = "Segment Spine, X pre-translation, invalid expresssion: Parse Error at column 4: ID "
	                            "\"Leg\" was referenced but never declared";
	EXPECT_EQ(Listed(m_Subject), (VTexts{"parameter 0 Leg: " + unknown, "segment 1 Spine: " + segment}));
}

TEST_F(SubjectCheckParametrised, StepsFollowWhateverWasFound)
{
	m_Subject.m_Markers[2].m_Name = "M0";
	m_Subject.m_Targets[1].m_SegmentIndices = {2};
	m_Subject.m_Targets[1].m_Weight = -1;
	m_Subject.m_Targets[1].m_ViewNormals.clear();
	m_Subject.m_Targets[8].m_RotationObservationIndices = {0, 0};
	auto& rSegment = m_Subject.m_Segments[1];
	rSegment.m_TreeDepth = 3;
	rSegment.m_SegmentIndex = 0;
	rSegment.m_Joint.m_RangeMatrix = rSegment.m_Joint.m_TemplateRangeMatrix = Diagonal(3, -1.0);
	rSegment.m_PreRotation[0] = "x";
	const std::string expression = "Segment Spine, X pre-rotation, invalid expresssion: Parse Error at column 2: ID "
	                               "\"x\" was referenced but never declared";
	EXPECT_EQ(Messages(),
	    (VTexts{"SubjectUtils: Could not evaluate m_PreRotation expressions in segment 'Spine'",
	        "Marker duplicate name: M0", "Invalid joint range matrix", "Inconsistent template range information.",
	        "Segment Spine, invalid template values", "Target 1, invalid weights or template values", expression}));
	// The list goes on after each element, and after each step of an element.
	EXPECT_EQ(Listed(m_Subject),
	    (VTexts{"marker 2 M0: Marker duplicate name: M0", "target 1 : Out of range segment index 2",
	        "target 1 : Invalid target view normals",
	        "target 8 ~ Incorrect number of rotation observations, ElocalRotationToWorldRotation type expects 1 "
	        "rotation "
	        "observation",
	        "segment 1 Spine: Invalid joint range matrix", "segment 1 Spine: Inconsistent range information.",
	        "segment 1 Spine: Inconsistent segment index.",
	        "segment 1 Spine: The tree depth of a child must be equal to the parent depth + 1",
	        // Of the other range matrix.
	        "segment 1 Spine: Invalid joint range matrix", "segment 1 Spine: Inconsistent template range information.",
	        "target 1 : Target 1, invalid weights or template values", "segment 1 Spine: " + expression}));
	EXPECT_EQ(TakeLog(), VTexts{}) << "the list tells the log nothing";
}

TEST_F(SubjectCheckParametrised, StatisticsThatStopTheConversionAreListed)
{
	VJoint& rJoint = m_Subject.m_Segments[1].m_Joint;
	rJoint.m_Mean.resize(4);
	rJoint.m_RangeMatrix.resize(2);
	EXPECT_EQ(Messages(), VTexts{"SubjectUtils: Could not generate joint for segment 'Spine'"});
	EXPECT_EQ(Listed(m_Subject),
	    (VTexts{"segment 1 Spine: Incorrent 'Mean' vector size.", "segment 1 Spine: Incorrect 'RangeMatrix' size.",
	        "segment 1 Spine: Inconsistent range information."}));
	rJoint = {};
	rJoint.m_JointType = VJoint::EBall;
	// Nothing at all converts, but is not enough.
	EXPECT_EQ(Messages(), (VTexts{"Incorrent 'Mean' vector size.", "Incorrect 'Covariance' vector size."}));
}

} // namespace Parametrised
