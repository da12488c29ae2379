#include "CameraChecks.h"

#include "CoreGraphics/InteractionMapper.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>

using namespace CoreGraphics;
using GraphicsTest::ExpectNear;
using GraphicsTest::OnScreen;

namespace
{

constexpr double c_Degree = M_PI / 180.0;
const QSize c_Size(1280, 720);

void ExpectNear(const QVector3D& i_rActual, const QVector3D& i_rExpected, float i_Tolerance)
{
	for (int axis = 0; axis < 3; ++axis)
		EXPECT_NEAR(i_rActual[axis], i_rExpected[axis], i_Tolerance) << "axis " << axis;
}

class CameraController : public testing::Test
{
protected:
	void SetUp() override
	{
		VInteractionMapper::SetActive(m_pMapper);
		m_Camera.SetSize(c_Size);
		m_Camera.Update();
	}

	void Drag(std::uint32_t i_Buttons, const QPoint& i_rFrom, const QPoint& i_rTo)
	{
		m_Camera.Press(i_rFrom, i_Buttons, 0);
		m_Camera.Move(i_rTo);
		m_Camera.Release(0, 0);
		m_Camera.Update();
	}

	std::shared_ptr<VInteractionMapper> m_pMapper = std::make_shared<VInteractionMapper>();
	VCameraController m_Camera;
};

} // namespace

TEST_F(CameraController, BeginsWithTheWholeStage)
{
	EXPECT_EQ(m_Camera.m_Near, 1.0f);
	EXPECT_EQ(m_Camera.m_Far, 100000.0f);
	EXPECT_EQ(m_Camera.m_FieldOfView, 45.0f);
	EXPECT_EQ(m_Camera.m_Pitch, -60.0f);
	EXPECT_EQ(m_Camera.m_Yaw, 45.0f);
	EXPECT_EQ(m_Camera.m_Distance, 7000.0f);
	EXPECT_EQ(m_Camera.m_OrthographicScale, 4.0f);
	EXPECT_EQ(m_Camera.m_Centre, QVector3D());
	EXPECT_TRUE(m_Camera.m_FrameOfReference.isIdentity());
	EXPECT_EQ(m_Camera.m_Type, ECameraPerspective);
	EXPECT_FALSE(m_Camera.m_bYUp);
}

TEST_F(CameraController, PerspectiveLooksFromASphereRoundTheCentre)
{
	for (const bool bYUp : {false, true})
	{
		for (const auto& [pitch, yaw] : {std::pair(-60.0f, 45.0f), {-90.0f, 0.0f}, {-10.0f, 200.0f}, {-135.0f, -30.0f}})
		{
			SCOPED_TRACE(testing::Message() << pitch << ", " << yaw << (bYUp ? ", Y up" : ""));
			m_Camera.m_Pitch = pitch;
			m_Camera.m_Yaw = yaw;
			m_Camera.m_bYUp = bYUp;
			m_Camera.m_Centre = QVector3D(100.0f, -200.0f, 900.0f);
			m_Camera.m_Distance = 3000.0f;
			m_Camera.Update();
			// With Z up; Y up is the same with the Y axis where Z was, and Z where -Y was.
			const auto turned = [&](double i_X, double i_Y, double i_Z) {
				return bYUp ? QVector3D(float(i_X), float(i_Z), float(-i_Y))
				            : QVector3D(float(i_X), float(i_Y), float(i_Z));
			};
			const double p = pitch * c_Degree, y = yaw * c_Degree;
			const QVector3D back = turned(std::sin(y) * std::sin(p), std::cos(y) * std::sin(p), std::cos(p));
			QMatrix4x4 expected;
			expected.lookAt(m_Camera.m_Centre + 3000.0f * back, m_Camera.m_Centre, turned(0.0, 0.0, 1.0));
			ExpectNear(m_Camera.m_View, expected, 2e-3f, 2e-3f);
		}
	}
	// Depth of the near and the far plane, and the edge of the view at half of 45 degrees.
	const double t = std::tan(22.5 * c_Degree);
	ExpectNear(
	    m_Camera.m_Projection.map(QVector3D(0.0f, 100.0f * float(t), -100.0f)), QVector3D(0.0f, 1.0f, 0.98002f), 1e-4f);
	EXPECT_NEAR(
	    m_Camera.m_Projection.map(QVector3D(100.0f * float(t * 1280.0 / 720.0), 0.0f, -100.0f)).x(), 1.0f, 1e-5f);
	EXPECT_NEAR(m_Camera.m_Projection.map(QVector3D(0.0f, 0.0f, -1.0f)).z(), -1.0f, 1e-4f);
	EXPECT_NEAR(m_Camera.m_Projection.map(QVector3D(0.0f, 0.0f, -100000.0f)).z(), 1.0f, 1e-4f);
}

TEST_F(CameraController, FixedViewsLookAlongTheAxes)
{
	struct VRow
	{
		std::uint32_t m_Type;
		bool m_bYUp;
		/// What points to the right, up, and out of the screen.
		QVector3D m_Right, m_Up, m_Back;
	};
	const QVector3D x(1, 0, 0), y(0, 1, 0), z(0, 0, 1);
	const VRow rows[] = {{ECameraFront, false, -x, z, y}, {ECameraBack, false, x, z, -y},
	    {ECameraLeft, false, -y, z, -x}, {ECameraRight, false, y, z, x}, {ECameraTop, false, -x, -y, z},
	    {ECameraBottom, false, -x, y, -z}, {ECameraFront, true, x, y, z}, {ECameraBack, true, -x, y, -z},
	    {ECameraLeft, true, -z, y, x}, {ECameraRight, true, z, y, -x}, {ECameraTop, true, x, -z, y},
	    {ECameraBottom, true, x, z, -y}};
	const QVector3D centre(10.0f, 20.0f, 30.0f);
	m_Camera.m_Centre = centre;
	for (const VRow& rRow : rows)
	{
		SCOPED_TRACE(testing::Message() << "type " << rRow.m_Type << (rRow.m_bYUp ? ", Y up" : ""));
		m_Camera.m_Type = rRow.m_Type;
		m_Camera.m_bYUp = rRow.m_bYUp;
		m_Camera.Update();
		ExpectNear(m_Camera.m_View.map(centre), QVector3D(0.0f, 0.0f, -50000.0f), 1e-2f);
		ExpectNear(m_Camera.m_View.mapVector(rRow.m_Right), x, 1e-6f);
		ExpectNear(m_Camera.m_View.mapVector(rRow.m_Up), y, 1e-6f);
		ExpectNear(m_Camera.m_View.mapVector(rRow.m_Back), z, 1e-6f);
		// 4 mm a pixel.
		const QPointF place = OnScreen(m_Camera, centre + 400.0f * rRow.m_Right + 40.0f * rRow.m_Up);
		EXPECT_NEAR(place.x(), 740.0, 0.01);
		EXPECT_NEAR(place.y(), 350.0, 0.01);
	}
}

TEST_F(CameraController, FollowsAFrameOfReference)
{
	m_Camera.m_FrameOfReference.translate(500.0f, 0.0f, 100.0f);
	m_Camera.m_FrameOfReference.rotate(30.0f, 0.0f, 0.0f, 1.0f);
	m_Camera.m_Centre = QVector3D(1.0f, 2.0f, 3.0f);
	m_Camera.Update();
	const QVector3D inFrame(1.0f, 2.0f, 3.0f);
	const QVector3D inWorld(500.0f + float(std::cos(30 * c_Degree) - 2 * std::sin(30 * c_Degree)),
	    float(std::sin(30 * c_Degree) + 2 * std::cos(30 * c_Degree)), 103.0f);
	ExpectNear(m_Camera.m_FrameOfReference.map(inFrame), inWorld, 1e-3f);
	ExpectNear(m_Camera.m_View.map(inWorld), QVector3D(0.0f, 0.0f, -7000.0f), 0.02f);
}

TEST_F(CameraController, APanTakesTheCentreAlongWithTheMouse)
{
	for (std::uint32_t type = ECameraPerspective; type < ECameraTypeCount; ++type)
	{
		for (const bool bYUp : {false, true})
		{
			SCOPED_TRACE(testing::Message() << "type " << type << (bYUp ? ", Y up" : ""));
			m_Camera.Reset(false);
			m_Camera.m_Type = type;
			m_Camera.m_bYUp = bYUp;
			m_Camera.Update();
			const QVector3D before = m_Camera.m_Centre;
			Drag(EButtonLeft | EButtonRight, {300, 300}, {337, 281});
			const QPointF place = OnScreen(m_Camera, before);
			EXPECT_NEAR(place.x(), 640.0 + 37.0, 0.02);
			EXPECT_NEAR(place.y(), 360.0 - 19.0, 0.02);
		}
	}
}

TEST_F(CameraController, OrbitTurnsTheFreeViewAlone)
{
	Drag(EButtonLeft, {100, 100}, {150, 90});
	EXPECT_FLOAT_EQ(m_Camera.m_Yaw, 55.0f);
	EXPECT_FLOAT_EQ(m_Camera.m_Pitch, -62.0f);
	// A second button keeps the place where the drag is, and makes a pan of it.
	m_Camera.Press({100, 100}, EButtonLeft, 0);
	m_Camera.Move({110, 100});
	m_Camera.Press({500, 500}, EButtonLeft | EButtonRight, 0);
	EXPECT_FALSE(m_Camera.m_bRotate);
	EXPECT_TRUE(m_Camera.m_bTranslate);
	EXPECT_EQ(m_Camera.m_LastMouse, QPoint(110, 100));
	m_Camera.Release(EButtonRight, 0);
	EXPECT_TRUE(m_Camera.m_bDolly);
	m_Camera.Release(0, 0);
	EXPECT_FALSE(m_Camera.m_bTranslate || m_Camera.m_bRotate || m_Camera.m_bDolly);

	for (std::uint32_t type = ECameraFront; type < ECameraTypeCount; ++type)
	{
		m_Camera.m_Type = type;
		m_Camera.Update();
		const QMatrix4x4 view = m_Camera.m_View;
		Drag(EButtonLeft, {100, 100}, {150, 90});
		EXPECT_EQ(m_Camera.m_View, view) << type;
	}
}

TEST_F(CameraController, TheWheelInFixedViewsIsTheHostsChoice)
{
	m_Camera.m_Type = CoreGraphics::ECameraLeft;
	m_Camera.Wheel(-120);
	EXPECT_FLOAT_EQ(m_Camera.m_OrthographicScale, 4.0f);
	m_Camera.Wheel(-120, true);
	EXPECT_FLOAT_EQ(m_Camera.m_OrthographicScale, 4.4f);
	EXPECT_FLOAT_EQ(m_Camera.m_Distance, 7700.0f) << "of the free view";
}

TEST_F(CameraController, DollyAndWheelStayWithinTheirLimits)
{
	Drag(EButtonRight, {0, 0}, {0, 10});
	EXPECT_FLOAT_EQ(m_Camera.m_Distance, 7150.0f);
	m_Camera.Wheel(-120);
	EXPECT_FLOAT_EQ(m_Camera.m_Distance, 7865.0f);
	m_Camera.Wheel(120);
	EXPECT_FLOAT_EQ(m_Camera.m_Distance, 7078.5f);
	for (int i = 0; i < 200; ++i)
		m_Camera.Wheel(-120);
	EXPECT_EQ(m_Camera.m_Distance, 50000.0f);
	for (int i = 0; i < 200; ++i)
		m_Camera.Wheel(120);
	EXPECT_EQ(m_Camera.m_Distance, 10.0f);
	Drag(EButtonRight, {0, 0}, {0, -100000});
	EXPECT_EQ(m_Camera.m_Distance, 10.0f);

	m_Camera.m_Type = ECameraTop;
	Drag(EButtonRight, {0, 0}, {0, 40});
	EXPECT_FLOAT_EQ(m_Camera.m_OrthographicScale, 4.4f);
	EXPECT_FLOAT_EQ(m_Camera.m_Projection(0, 0), 2.0f / (1280.0f * 4.4f));
	Drag(EButtonRight, {0, 0}, {0, -1000});
	EXPECT_EQ(m_Camera.m_OrthographicScale, 0.001f);
	for (int i = 0; i < 20; ++i)
		Drag(EButtonRight, {0, 0}, {0, 10000});
	EXPECT_EQ(m_Camera.m_OrthographicScale, 1000.0f);
	const QMatrix4x4 projection = m_Camera.m_Projection;
	m_Camera.Wheel(120);
	m_Camera.Update();
	EXPECT_EQ(m_Camera.m_Projection, projection);
}

TEST_F(CameraController, ResetGoesNearOrFar)
{
	for (const bool bClose : {true, false})
	{
		m_Camera.m_Centre = QVector3D(1, 2, 3);
		m_Camera.m_OrthographicScale = 9.0f;
		m_Camera.m_FrameOfReference.translate(1, 2, 3);
		m_Camera.Reset(bClose);
		EXPECT_EQ(m_Camera.m_Pitch, bClose ? -90.0f : -60.0f);
		EXPECT_EQ(m_Camera.m_Yaw, bClose ? 0.0f : 45.0f);
		EXPECT_EQ(m_Camera.m_Distance, bClose ? 1000.0f : 7000.0f);
		EXPECT_EQ(m_Camera.m_OrthographicScale, 4.0f);
		EXPECT_EQ(m_Camera.m_Centre, QVector3D());
		EXPECT_TRUE(m_Camera.m_FrameOfReference.isIdentity());
	}
}

TEST_F(CameraController, FitFillsTheViewToTheMargin)
{
	const std::vector<QVector4D> bounds = {
	    {0, 0, 1000, 50}, {800, -300, 1400, 20}, {-900, 100, 200, 5}, {0, 0, 0, 400}};
	for (const QSize& rSize : {QSize(1280, 720), QSize(300, 900)})
	{
		for (std::uint32_t type = ECameraPerspective; type < ECameraTypeCount; ++type)
		{
			SCOPED_TRACE(testing::Message() << "type " << type << ", width " << rSize.width());
			m_Camera.m_Type = type;
			m_Camera.SetSize(rSize);
			m_Camera.Fit(bounds, true);
			m_Camera.Update();
			ExpectNear(m_Camera.m_Centre, QVector3D(-42.5f, 0.0f, 510.0f), 1e-3f);
			// The largest way of a sphere with its margin beyond an edge of the view: it touches one, and is within
			// all.
			double beyond = -std::numeric_limits<double>::infinity();
			const double aspect = double(rSize.width()) / rSize.height();
			for (const QVector4D& rSphere : bounds)
			{
				const QVector3D place = m_Camera.m_View.map(rSphere.toVector3D());
				const double reach = rSphere.w() + 250.0;
				for (const auto& [across, share] : {std::pair(double(place.x()), aspect), {double(place.y()), 1.0}})
				{
					const double t = std::tan(22.5 * c_Degree) * share;
					const double half = 0.5 * m_Camera.m_OrthographicScale * rSize.height() * share;
					beyond = std::max(beyond,
					    type == ECameraPerspective ? (std::abs(across) + place.z() * t) / std::hypot(1.0, t) + reach
					                               : std::abs(across) + reach - half);
				}
			}
			EXPECT_NEAR(beyond, 0.0, 0.05);
		}
	}
}

TEST_F(CameraController, FitChangesNothingWithoutBounds)
{
	const float nan = std::numeric_limits<float>::quiet_NaN();
	const float infinity = std::numeric_limits<float>::infinity();
	for (const auto& rBounds : {std::vector<QVector4D>{}, {{nan, 0, 0, 1}}, {{0, infinity, 0, 1}}})
	{
		m_Camera.m_Centre = QVector3D(7, 8, 9);
		m_Camera.Fit(rBounds, true);
		EXPECT_EQ(m_Camera.m_Centre, QVector3D(7, 8, 9));
		EXPECT_EQ(m_Camera.m_Distance, 7000.0f);
	}
	// The middle alone.
	m_Camera.Fit({{100, 0, 0, 10}, {nan, nan, nan, nan}}, false);
	EXPECT_EQ(m_Camera.m_Centre, QVector3D(100, 0, 0));
	EXPECT_EQ(m_Camera.m_Distance, 7000.0f);
	// A view of no size has no distance that would fit, and bounds without end are too far.
	m_Camera.SetSize(QSize(0, 0));
	m_Camera.Fit({{0, 0, 0, 10}}, true);
	EXPECT_EQ(m_Camera.m_Distance, 7000.0f);
	m_Camera.SetSize(c_Size);
	m_Camera.Fit({{0, 0, 0, 1e9f}}, true);
	EXPECT_EQ(m_Camera.m_Distance, 50000.0f);
}
