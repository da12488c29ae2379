#include "../OrlexGraphics/ViewFixture.h"
#include "../PictureTest.h"

#include "Flow2Graphics/SubjectTypes.h"
#include "TestSubject.h"

#include <QQmlComponent>
#include <QQuickItem>

namespace
{

using namespace Flow2Graphics;

/// Where the cameras of a stage stand no item tells yet.
class VStageScene : public VFlowScene
{
public:
	using VFlowScene::VFlowScene;
	void Refresh() override
	{
		m_Overlay.m_Cameras = {{"seen", 1, {0, 250, 100}, true}, {"beyond", 2, {-3000, 3000, 1500}, false}};
		VFlowScene::Refresh();
	}
};

/// A window that shows the small subject, as QML and the mouse see it.
class ViewPictures : public VViewTest
{
protected:
	void ShowStage(bool i_bFloor)
	{
		m_pStage = std::make_shared<VStageScene>(m_pShaders, m_pSelection, nullptr, m_pDispatcher, false);
		ASSERT_NO_FATAL_FAILURE(Show(m_pStage));
		Resize(320, 240);
		m_pView->SetCameraType(CoreGraphics::ECameraPerspective);
		CoreGraphics::VCameraController& rCamera = m_pView->Camera();
		rCamera.m_Centre = QVector3D(0, 170, 110);
		rCamera.m_Distance = 700.0f;
		rCamera.m_Pitch = -65.0f;
		rCamera.m_Yaw = 60.0f;
		SetOption("FloorGrid", i_bFloor);
		Pose(TestSubject::MakePose());
	}

	void Pose(const CoreOrlexTypes::VSubjectDynamicParameters& i_rPose)
	{
		m_pStage->SetFrame(TestSubject::MakeSubjectFrame(VFlowSubjectForSolvingTypes::c_Types, nullptr, i_rPose));
	}

	/// What was asked for is drawn, and what that led to is drawn as well.
	void Compare(const std::string& i_rName)
	{
		for (int i = 0; i < 6; ++i)
		{
			QCoreApplication::processEvents();
			Grab();
		}
		EXPECT_TRUE(PictureTest::Matches(Grab(), i_rName));
	}

	NVX::ISelectionItem Segment(std::uint32_t i_Index) const { return m_Items.Segment(TestSubject::c_Id, i_Index); }

	const VSubjectSelectionMaker<VFlowSubjectForSolvingTypes> m_Items{};
	std::shared_ptr<VStageScene> m_pStage;
};

} // namespace

TEST_F(ViewPictures, OfTheTrackingModes)
{
	CoreOrlexTypes::VSubjectDynamicParameters moved = TestSubject::MakePose();
	moved.m_State[2] += 0.6;
	moved.m_State[3] += 250.0;
	const struct
	{
		const char* m_pBefore;
		const char* m_pName;
		OrlexGraphics::ETracking m_Tracking;
	} c_Rows[] = {
	    {"tracking-none-before", "tracking-none", OrlexGraphics::ETrackingNone},
	    {"tracking-selection-before", "tracking-selection-then", OrlexGraphics::ETrackingSelectionThen},
	    {"tracking-selection-before", "tracking-selection", OrlexGraphics::ETrackingSelection},
	    {"tracking-transform-before", "tracking-transform", OrlexGraphics::ETrackingTransform},
	};
	for (const auto& rRow : c_Rows)
	{
		m_pSelection->Selection().Replace({Segment(TestSubject::ELimb)});
		ASSERT_NO_FATAL_FAILURE(ShowStage(true));
		m_pView->SetTracking(rRow.m_Tracking);
		Compare(rRow.m_pBefore);
		// Another selection, and the subject goes on.
		m_pSelection->Selection().Replace({Segment(TestSubject::ERoot)});
		Pose(moved);
		Compare(rRow.m_pName);
		Close();
	}
}

TEST_F(ViewPictures, OfASelectionRectangle)
{
	ASSERT_NO_FATAL_FAILURE(ShowStage(false));
	m_pSelection->Selection().Replace({Segment(TestSubject::ERoot)});
	for (const Qt::KeyboardModifiers modifiers : {Qt::KeyboardModifiers(Qt::NoModifier), {Qt::ShiftModifier}})
	{
		const std::string name = modifiers ? "rectangle-to-add" : "rectangle";
		Press({210, 60}, modifiers | Qt::AltModifier);
		Drag({60, 150}, modifiers | Qt::AltModifier);
		Compare(name);
		Release({60, 150}, modifiers | Qt::AltModifier);
		ASSERT_TRUE(Commit());
		Leave();
		Compare(name + "-selected");
		m_pSelection->Selection().Replace({Segment(TestSubject::ERoot)});
	}
}

TEST_F(ViewPictures, OfWhatQmlLaysOverTheView)
{
	ASSERT_NO_FATAL_FAILURE(ShowStage(false));
	QQmlComponent component(m_pWidget->engine());
	component.setData(R"(
		import QtQuick 2.12
		Item {
			id: overlay
			property var view
			anchors.fill: parent
			Repeater {
				model: overlay.view.subjectObjects
				Rectangle {
					x: overlay.width / 2 + modelData.position.x - width / 2
					y: overlay.height / 2 + modelData.position.y - height / 2
					width: 40; height: 12; radius: 6; color: "#e76500"
				}
			}
			Repeater {
				model: overlay.view.cameraObjects
				Rectangle {
					x: overlay.width / 2 + modelData.position.x - width / 2
					y: overlay.height / 2 + modelData.position.y - height / 2
					width: modelData.offscreen ? 6 : 16; height: 16
					rotation: modelData.offscreen ? -modelData.rotationDegrees : 0
					color: modelData.calibrated ? "#40c040" : "#c0c040"
				}
			}
		})",
	    QUrl());
	const std::unique_ptr<QObject> pOverlay(
	    component.createWithInitialProperties({{"view", QVariant::fromValue<QObject*>(m_pView)}}));
	auto* const pItem = qobject_cast<QQuickItem*>(pOverlay.get());
	ASSERT_TRUE(pItem) << component.errorString().toStdString();
	pItem->setParentItem(m_pView);
	Compare("overlay-objects");
}
