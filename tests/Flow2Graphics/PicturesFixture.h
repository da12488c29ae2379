#pragma once

#include "../CoreGraphics/CameraChecks.h"
#include "../OrlexGraphics/SceneFixture.h"
#include "../PictureTest.h"
#include "TestSubject.h"

#include "Flow2Graphics/FlowScene.h"
#include "OrlexGraphics/item/SceneOptionsMap.h"

#include <QImage>
#include <QQmlPropertyMap>

struct VView
{
	QVector3D m_Centre = {};
	float m_Distance = 1000.0f;
	float m_Pitch = -70.0f;
	float m_Yaw = 30.0f;
	std::uint32_t m_Type = CoreGraphics::ECameraPerspective;
	/// Millimetres of a pixel, where there is no perspective.
	float m_Scale = 10.0f;
};

/// Of the small subject.
inline const VView c_Small{{0, 170, 110}, 460.0f, -65.0f, 60.0f};

/// Frames of the flow scene, without floor and axes unless a test wants them.
class VPicturesTest : public VSceneTest
{
protected:
	VPicturesTest() : VSceneTest(QSize(320, 240)) {}

	void SetUp() override
	{
		ASSERT_NO_FATAL_FAILURE(VSceneTest::SetUp());
		m_pScene = Show<Flow2Graphics::VFlowScene>();
		Options().m_bFloorGrid = Options().m_bGlobalAxis = false;
	}

	/// With the arguments of TestSubject::MakeSubjectFrame.
	void ShowSmall(const auto&... i_rArguments) { m_pScene->SetFrame(TestSubject::MakeSubjectFrame(i_rArguments...)); }

	CoreGraphics::VCameraController& SetView(const VView& i_rView)
	{
		CoreGraphics::VCameraController& rCamera = Camera();
		rCamera.m_Centre = i_rView.m_Centre;
		rCamera.m_Distance = i_rView.m_Distance;
		rCamera.m_Pitch = i_rView.m_Pitch;
		rCamera.m_Yaw = i_rView.m_Yaw;
		rCamera.m_Type = i_rView.m_Type;
		rCamera.m_OrthographicScale = i_rView.m_Scale;
		rCamera.m_bYUp = m_pScene->YUp();
		rCamera.SetSize(m_Size);
		rCamera.Update();
		return rCamera;
	}

	/// As QML does it: of the options of a class, these alone.
	void ShowOnly(const QString& i_rClass, const QStringList& i_rOptions)
	{
		QQmlPropertyMap map;
		OrlexGraphics::WriteOptionsToMap(Options(), map);
		for (const QString& rKey : map.keys())
			if (rKey.startsWith(i_rClass + '-'))
				map.insert(rKey, i_rOptions.contains(rKey.mid(i_rClass.size() + 1)));
		EXPECT_TRUE(OrlexGraphics::ReadOptionsFromMap(map, Options()));
	}

	QImage Draw(const VView& i_rView)
	{
		SetView(i_rView);
		Frame();
		return m_pTarget->toImage().convertToFormat(QImage::Format_RGB32);
	}

	std::vector<NVX::ISelectionItem> PickAt(const QVector3D& i_rPlace)
	{
		return Pick(GraphicsTest::OnScreen(Camera(), i_rPlace).toPoint());
	}

	/// Beside the stored one of the dialect: OpenGL ES has no samples, its edges are steps.
	void Compare(const QImage& i_rImage, const std::string& i_rName)
	{
		EXPECT_TRUE(
		    PictureTest::Matches(i_rImage, (GetParam() == GraphicsTest::EDialect::ES2 ? "es2-" : "") + i_rName));
	}

	std::shared_ptr<Flow2Graphics::VFlowScene> m_pScene;
};
