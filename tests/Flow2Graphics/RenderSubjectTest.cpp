#include "../UtilsFileSystem/Log.h"
#include "Flow2Graphics/FlowRenderSubjectList.h"
#include "Flow2Graphics/SubjectShapes.h"
#include "OrlexGraphics/picking/SelectionRegistry.h"
#include "TestSubject.h"

#include <gtest/gtest.h>

#include <cmath>
#include <set>

namespace
{

using namespace Flow2Graphics;
using namespace TestSubject;
using CoreOrlexTypes::VReconstructionLabelSet;
using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectDynamicParameters;

/// Columns of a matrix that takes no perspective.
void ExpectMatrix(const QMatrix4x4& i_rMatrix, const QVector3D& i_rX, const QVector3D& i_rY, const QVector3D& i_rZ,
    const QVector3D& i_rOrigin)
{
	const QVector3D expected[] = {i_rX, i_rY, i_rZ, i_rOrigin};
	for (int column = 0; column < 4; ++column)
		EXPECT_LT((i_rMatrix.column(column).toVector3D() - expected[column]).length(), 1e-3f)
		    << column << ": " << i_rMatrix(0, column) << " " << i_rMatrix(1, column) << " " << i_rMatrix(2, column);
}

void ExpectVector(const QVector4D& i_rVector, const QVector4D& i_rExpected)
{
	EXPECT_LT((i_rVector - i_rExpected).length(), 1e-3f)
	    << i_rVector.x() << " " << i_rVector.y() << " " << i_rVector.z() << " " << i_rVector.w();
}

class RenderSubject : public testing::Test
{
protected:
	void Make(VSubject i_Subject, VSubjectApplicationData i_Data)
	{
		m_pSubject = std::make_unique<VFlowRenderSubject>(std::make_shared<const VSubject>(std::move(i_Subject)),
		    std::make_shared<const VSubjectApplicationData>(std::move(i_Data)), m_pMaker);
	}

	void Update(const VSubjectDynamicParameters* i_pPose, const VReconstructionLabelSet* i_pLabels = nullptr,
	    const QMatrix4x4& i_rTransform = {})
	{
		m_Registry.Reset();
		m_pSubject->Update({i_pPose, i_pLabels}, m_Registry, i_rTransform);
	}

	void Show()
	{
		Make(TestSubject::Make(), MakeData());
		Update(&m_Pose);
	}

	const VRenderSubjectData& Data() const { return *m_pSubject->Data(); }
	const VRenderSubjectMarkerData& Markers() const { return *m_pSubject->Markers(); }
	std::uint32_t SegmentId(std::uint32_t i_Index) { return m_Registry.GetId(m_pMaker->Segment(c_Id, i_Index)).m_Id; }

	const std::shared_ptr<const ISubjectSelectionMaker> m_pMaker =
	    std::make_shared<const VSubjectSelectionMaker<VFlowSubjectForSolvingTypes>>();
	const VSubjectDynamicParameters m_Pose = MakePose();
	OrlexGraphics::VSelectionRegistry m_Registry;
	std::unique_ptr<VFlowRenderSubject> m_pSubject;
};

TEST_F(RenderSubject, AxesSpheresAndJoints)
{
	Show();
	const QVector3D places[] = {{10, 20, 30}, {10, 20, 130}, {10, 320, 130}, {-40, 320, 130}, {10, 20, 130}};
	const float radii[] = {0, 0, 0, 0, 5};
	const QVector4D colours[] = {{1, 0, 0, 1}, {0, 0.8f, 0.2f, 0.4f}, {0, 0, 1, 1},
	    {93 / 255.0f, 93 / 255.0f, 93 / 255.0f, 1}, {93 / 255.0f, 93 / 255.0f, 93 / 255.0f, 1}};
	ASSERT_EQ(Data().m_Axes.size(), 5u);
	ASSERT_EQ(Data().m_BoneSpheres.size(), 5u);
	for (std::uint32_t i = 0; i < ESegmentCount; ++i)
	{
		SCOPED_TRACE(i);
		ExpectMatrix(Data().m_Axes[i], {0, 1, 0}, {-1, 0, 0}, {0, 0, 1}, places[i]);
		ExpectVector(Data().m_BoneSpheres[i].m_PositionAndSize, QVector4D(places[i], radii[i]));
		ExpectVector(Data().m_BoneSpheres[i].m_Colour, colours[i]);
		EXPECT_EQ(Data().m_BoneSpheres[i].m_Id.m_Id, SegmentId(i));
	}
	ASSERT_EQ(Data().m_Joints.size(), 3u) << "the others do not move";
	for (std::uint32_t i = 0; i < 3; ++i)
		ExpectVector(Data().m_Joints[i].m_PositionAndSize, QVector4D(places[i], 10));
}

TEST_F(RenderSubject, BonesRunFromTheParentAndAreIts)
{
	Show();
	ASSERT_EQ(Data().m_Bones.size(), 3u) << "one without length is none";
	ExpectMatrix(Data().m_Bones[0].m_Matrix, {100, 0, 0}, {0, 100, 0}, {0, 0, 100}, {10, 20, 30});
	ExpectMatrix(Data().m_Bones[1].m_Matrix, {0, 0, -150}, {-150, 0, 0}, {0, 300, 0}, {10, 20, 130});
	EXPECT_NEAR(Data().m_Bones[2].m_Matrix.column(2).x(), -50, 1e-3) << "to a hidden segment, too";
	ExpectVector(Data().m_Bones[1].m_Colour, {0, 0.8f, 0.2f, 0.4f});
	for (std::uint32_t bone = 0; bone < 3; ++bone)
		EXPECT_EQ(Data().m_Bones[bone].m_Id.m_Id, SegmentId(bone)) << bone;

	VSubjectApplicationData data = MakeData();
	data.m_Segments[ESpine].m_DrawTwist = 90.0;
	data.m_Segments[ERoot].m_Visible = false;
	Make(TestSubject::Make(), data);
	Update(&m_Pose);
	ASSERT_EQ(Data().m_Bones.size(), 2u) << "not from a hidden parent";
	ExpectMatrix(Data().m_Bones[0].m_Matrix, {-150, 0, 0}, {0, 0, 150}, {0, 300, 0}, {10, 20, 130});
}

TEST_F(RenderSubject, ASingleSegmentIsABoneByItsStyle)
{
	VSubject subject = TestSubject::Make();
	subject.m_Segments.resize(1);
	subject.m_Targets.clear();
	VSubjectApplicationData data = MakeData();
	Make(subject, data);
	Update(&m_Pose);
	EXPECT_TRUE(Data().m_Bones.empty());
	data.m_Segments[0].m_DrawStyle = VSubjectApplicationData::VSegment::EDrawStyleTetraStripe;
	Make(subject, data);
	Update(&m_Pose);
	ASSERT_EQ(Data().m_Bones.size(), 1u);
	ExpectMatrix(Data().m_Bones[0].m_Matrix, {0, 100, 0}, {-100, 0, 0}, {0, 0, 100}, {10, 20, 30});
	EXPECT_EQ(Data().m_BoneSpheres[0].m_PositionAndSize.w(), 5.0f);
}

TEST_F(RenderSubject, PlatesStandAtTheRootAndWhereABodyIs)
{
	Show();
	ASSERT_EQ(Data().m_Boxes.size(), 2u);
	ExpectMatrix(Data().m_Boxes[0].m_Matrix, {0, 75, 0}, {-75, 0, 0}, {0, 0, 3}, {10, 20, 30});
	ExpectVector(Data().m_Boxes[0].m_Colour, {1, 0, 0, 1});
	EXPECT_EQ(Data().m_Boxes[0].m_Id, Data().m_Id) << "it picks the subject";
	EXPECT_EQ(Data().m_Id, m_Registry.GetId(m_pMaker->Subject(c_Id)));
	ExpectMatrix(Data().m_Boxes[1].m_Matrix, {0, 75, 0}, {-75, 0, 0}, {0, 0, 3}, {10, 320, 130});
	ExpectVector(Data().m_Boxes[1].m_Colour, {0, 0, 1, 0.5f});
	EXPECT_EQ(Data().m_Boxes[1].m_Id.m_Id, SegmentId(ELimb));
}

TEST_F(RenderSubject, TargetsAndTheirCovariances)
{
	Show();
	ASSERT_EQ(Data().m_PositionTargets.size(), 2u) << "the point and the body";
	ExpectVector(Data().m_PositionTargets[0].m_PositionAndSize, {0, 320, 130, 20});
	ExpectVector(Data().m_PositionTargets[0].m_Colour, {1, 1, 0, 1});
	ExpectVector(Data().m_PositionTargets[1].m_PositionAndSize, {10, 320, 190, 20});

	ASSERT_EQ(Data().m_RotationTargets.size(), 1u);
	// Rz(90) Rx(90): X to Y, Y to Z, Z to X.
	ExpectMatrix(Data().m_RotationTargets[0].m_Target, {0, 1, 0}, {0, 0, 1}, {1, 0, 0}, {10, 20, 130});
	ExpectMatrix(Data().m_RotationTargets[0].m_Segment, {0, 1, 0}, {-1, 0, 0}, {0, 0, 1}, {10, 20, 130});

	const NVX::ISelectionItem item = m_pMaker->Target(c_Id, EPoint);
	EXPECT_EQ(item.m_Kind, NVX::ESelectionTarget);
	EXPECT_EQ(m_Registry.GetName(Data().m_PositionTargets[0].m_Id.m_Id), "Ann Limb point");
	ASSERT_TRUE(m_Registry.GetItemBound(item) && m_Registry.GetItemMatrix(item));
	ExpectVector(*m_Registry.GetItemBound(item), {0, 320, 130, 10 * std::sqrt(3.0f)});
	ExpectMatrix(*m_Registry.GetItemMatrix(item), {0, 1, 0}, {-1, 0, 0}, {0, 0, 1}, {0, 320, 130});

	ASSERT_EQ(Data().m_Covariances.size(), 1u);
	QMatrix4x4 linear = Data().m_Covariances[0];
	ExpectVector(linear.column(3), {0, 320, 130, 1});
	linear.setColumn(3, {0, 0, 0, 1});
	EXPECT_GT(linear.determinant(), 0.0f) << "or it would be inside out";
	// The covariance turned into the world.
	ExpectMatrix(linear * linear.transposed(), {900, 0, 0}, {0, 400, 0}, {0, 0, 1600}, {0, 0, 0});

	VSubjectApplicationData data = MakeData();
	data.m_Targets[EPoint].m_Visible = false;
	Make(TestSubject::Make(), data);
	Update(&m_Pose);
	EXPECT_EQ(Data().m_PositionTargets.size(), 1u);
	EXPECT_TRUE(Data().m_Covariances.empty());
}

TEST_F(RenderSubject, ItemsHaveNamesBoundsAndPlaces)
{
	Show();
	NVX::ISelectionItem item;
	ASSERT_TRUE(m_Registry.ResolveId(SegmentId(ELimb), item));
	EXPECT_EQ(item, (NVX::ISelectionItem{NVX::ESelectionTargetSegment, c_Id, ELimb, {}}));
	EXPECT_EQ(m_Registry.GetName(SegmentId(ELimb)), "Ann : Limb");
	EXPECT_EQ(m_Registry.GetName(Data().m_Id.m_Id), "Ann");
	ExpectVector(*m_Registry.GetItemBound(m_pMaker->Subject(c_Id)), {10, 20, 30, 1000});
	ExpectVector(*m_Registry.GetItemBound(m_pMaker->Segment(c_Id, EShort)), {10, 20, 130, 5});
	ExpectMatrix(
	    *m_Registry.GetItemMatrix(m_pMaker->Segment(c_Id, ELimb)), {0, 1, 0}, {-1, 0, 0}, {0, 0, 1}, {10, 320, 130});

	const auto label = m_pSubject->Label(false);
	ASSERT_TRUE(label);
	EXPECT_EQ(label->m_Name, "Ann");
	EXPECT_EQ(label->m_Position, QVector3D(10, 20, 130));
}

TEST_F(RenderSubject, MarkersMissingAndPresent)
{
	Show();
	ASSERT_EQ(Markers().m_Markers.size(), 3u) << "without labels nothing is missing";
	ExpectVector(Markers().m_Markers[0].m_PositionAndSize, {0, 320, 130, 7});
	ExpectVector(Markers().m_Markers[1].m_PositionAndSize, {10, 360, 190, 7});
	EXPECT_TRUE(Data().m_MissingMarkers.empty());
	EXPECT_EQ(Markers().m_SticksWithoutGaps, 2u);
	for (const float health : m_pSubject->SegmentHealth())
		EXPECT_EQ(health, 1.0f);

	const VReconstructionLabelSet labels{
	    {{c_Id, 0, {1, 2, 3}}, {c_Id, 1, {4, 5, 6}}, {c_Id + 1, 2, {7, 8, 9}}, {c_Id, 3, {9, 9, 9}}}};
	Update(&m_Pose, &labels);
	ASSERT_EQ(Markers().m_Markers.size(), 2u);
	ExpectVector(Markers().m_Markers[1].m_PositionAndSize, {4, 5, 6, 7});
	ASSERT_EQ(Data().m_MissingMarkers.size(), 1u) << "at the place where it is expected";
	ExpectVector(Data().m_MissingMarkers[0].m_PositionAndSize, {10, 280, 190, 7});
	ExpectVector(Data().m_MissingMarkers[0].m_Colour, {0, 1, 1, 1});
	EXPECT_EQ(m_pSubject->SegmentHealth()[ELimb], 0.0f) << "its body lacks a marker";
	EXPECT_EQ(m_pSubject->SegmentHealth()[ESpine], 1.0f);
	ASSERT_EQ(Markers().m_Sticks.size(), 2u);
	EXPECT_EQ(Markers().m_SticksWithoutGaps, 1u);
	ExpectVector(Markers().m_Sticks[0].m_Matrix.map(QVector4D(0, 0, 0, 1)), {1, 2, 3, 1});
	ExpectVector(Markers().m_Sticks[0].m_Matrix.map(QVector4D(0, 0, 1, 1)), {4, 5, 6, 1});
	ExpectVector(Markers().m_Sticks[0].m_ColourB, {0, 0, 1, 1});

	Update(&m_Pose);
	EXPECT_EQ(m_pSubject->SegmentHealth()[ELimb], 1.0f);

	VSubject subject = TestSubject::Make();
	subject.m_Markers[2].m_Missing = true;
	Make(subject, MakeData());
	Update(&m_Pose, &labels);
	EXPECT_TRUE(Data().m_MissingMarkers.empty()) << "it is known not to be worn";

	subject = TestSubject::Make();
	subject.m_Targets[TestSubject::EBody].m_SegmentIndices = {ELimb, ESpine};
	Make(subject, MakeData());
	Update(&m_Pose, &labels);
	EXPECT_EQ(m_pSubject->SegmentHealth()[ELimb], 1.0f) << "of two segments nobody knows which lacks the marker";
}

TEST_F(RenderSubject, StaysWhereItWasWithoutAPose)
{
	Make(TestSubject::Make(), MakeData());
	Update(nullptr);
	EXPECT_TRUE(Data().m_Axes.empty()) << "nobody knows where it is";
	EXPECT_EQ(Data().m_Id.m_Id, 0u);
	Update(&m_Pose);
	m_Registry.Reset();
	m_Registry.Allocate({99, 1, 1, {}});
	m_pSubject->Update({}, m_Registry, {});
	ASSERT_EQ(Data().m_Axes.size(), 5u);
	EXPECT_EQ(Data().m_BoneSpheres[ELimb].m_Id.m_Id, SegmentId(ELimb)) << "ids are this frame's";
	ExpectMatrix(Data().m_Axes[ELimb], {0, 1, 0}, {-1, 0, 0}, {0, 0, 1}, {10, 320, 130});

	for (const VSubjectDynamicParameters& rRefused :
	    {VSubjectDynamicParameters{c_Id + 1, {1, 1, 1, 1, 1, 1}}, VSubjectDynamicParameters{c_Id, {0, 0, NAN}}})
	{
		Update(&rRefused);
		ExpectMatrix(Data().m_Axes[ELimb], {0, 1, 0}, {-1, 0, 0}, {0, 0, 1}, {10, 320, 130});
	}
	const VSubjectDynamicParameters shorter{c_Id, {0, 0, 0, 1}};
	Update(&shorter);
	ExpectMatrix(Data().m_Axes[ELimb], {1, 0, 0}, {0, 1, 0}, {0, 0, 1}, {301, 0, 100});

	QMatrix4x4 aside;
	aside.translate(0, 1000, 0);
	Update(&m_Pose, nullptr, aside);
	ExpectMatrix(Data().m_Axes[ELimb], {0, 1, 0}, {-1, 0, 0}, {0, 0, 1}, {10, 1320, 130});
	ExpectVector(Markers().m_Markers[0].m_PositionAndSize, {0, 1320, 130, 7});
	ExpectVector(Data().m_PositionTargets[0].m_PositionAndSize, {0, 1320, 130, 20});
}

/// Kinematics count the markers that targets name, wherever in the list these stand, and have no place for directions.
TEST_F(RenderSubject, MarkersBehindOneThatNoTargetNames)
{
	VTestLog log("System");
	VSubject subject = TestSubject::Make();
	subject.m_Markers.insert(subject.m_Markers.begin(), VSubject::VMarker{"Spare", 0, 7.0, false, 0.0});
	subject.m_Rotations.insert(subject.m_Rotations.begin(), VSubject::VRotation{"Spare", 0});
	for (VSubject::VTarget& rTarget : subject.m_Targets)
	{
		for (std::uint32_t& rIndex : rTarget.m_MarkerIndices)
			++rIndex;
		for (std::uint32_t& rIndex : rTarget.m_RotationObservationIndices)
			++rIndex;
	}
	VSubject::VTarget direction = subject.m_Targets[ERotation];
	direction.m_Type = VSubject::VTarget::ELocalDirectionToWorldDirection;
	subject.m_Targets.insert(subject.m_Targets.begin(), direction);
	Make(subject, MakeData());
	Update(&m_Pose);
	EXPECT_EQ(log.Take(), std::vector<std::string>());
	ASSERT_EQ(Markers().m_Markers.size(), 3u) << "the spare one has no place";
	ExpectVector(Markers().m_Markers[0].m_PositionAndSize, {0, 320, 130, 7});
	ExpectVector(Markers().m_Markers[1].m_PositionAndSize, {10, 360, 190, 7});
	ExpectVector(Markers().m_Markers[2].m_PositionAndSize, {10, 280, 190, 7});
	EXPECT_EQ(Data().m_RotationTargets.size(), 1u);
	EXPECT_EQ(Data().m_PositionTargets.size(), 2u);
}

TEST_F(RenderSubject, TellsOnceOfKinematicsThatCannotBeBuilt)
{
	VTestLog log("Tessel");
	VSubject forward = TestSubject::Make();
	forward.m_Segments[ESpine].m_ParentSegmentIndex = ELimb;
	VSubject misfits = TestSubject::Make();
	misfits.m_Targets[EPoint].m_State.clear();
	misfits.m_Targets[EBody].m_MarkerIndices[1] = 3;
	const auto logged = [&](const VSubject& i_rSubject)
	{
		Make(i_rSubject, MakeData());
		Update(&m_Pose);
		Update(&m_Pose);
		return log.Take().size();
	};
	EXPECT_EQ(logged(forward), 1u);
	EXPECT_TRUE(Data().m_Axes.empty());
	EXPECT_EQ(logged(misfits), 2u);
	EXPECT_EQ(Data().m_Axes.size(), 5u);
	EXPECT_TRUE(Data().m_PositionTargets.empty());
	EXPECT_EQ(Data().m_RotationTargets.size(), 1u) << "the other target is shown";
}

TEST(SubjectTypes, NoTwoClassesShareAKind)
{
	std::set<std::uint32_t> kinds{1, 2, 3, 5, 27, 28, 31, 34};
	for (const VSubjectTypes& rTypes : c_SubjectTypes)
		for (const std::uint32_t kind :
		    {rTypes.m_SubjectKind, rTypes.m_SegmentKind, rTypes.m_TargetKind, rTypes.m_MarkerKind})
			EXPECT_TRUE(kinds.insert(kind).second) << kind;
	EXPECT_EQ(VFlowSubjectTypes::c_Types.m_SubjectKind, 7u);
	EXPECT_EQ(VFlowSubjectTypes::c_Types.m_SegmentKind, 11u);
	EXPECT_EQ(VFlowSubjectForSolvingTypes::c_Types.m_SegmentKind, 14u);
	EXPECT_EQ(VFlowSubjectForSolvingTypes::c_Types.m_TargetKind, 16u);
}

TEST(CovarianceMatrix, RefusesWhatIsNone)
{
	EXPECT_FALSE(CovarianceMatrix({}, {}, {}));
	EXPECT_FALSE(CovarianceMatrix({}, {}, std::vector<double>(36, 1.0)));
	EXPECT_FALSE(CovarianceMatrix({}, {}, std::vector<double>{NAN, 0, 0, 0, 1, 0, 0, 0, 1}));
	const auto flat = CovarianceMatrix({}, {}, std::vector<double>{-4, 0, 0, 0, 1, 0, 0, 0, 0});
	ASSERT_TRUE(flat);
	ExpectMatrix(*flat * flat->transposed(), {0, 0, 0}, {0, 1, 0}, {0, 0, 0}, {0, 0, 0});
}

} // namespace
