#include "OrlexGraphics/manipulator/ManipulatorDrag.h"

#include "../CoreGraphics/CameraChecks.h"

#include <cmath>

using namespace OrlexGraphics;
using CoreGraphics::VCameraController;
using GraphicsTest::ExpectNear;
using GraphicsTest::OnScreen;

namespace
{

constexpr float c_Degree = static_cast<float>(M_PI / 180.0);

VCameraController MakeCamera(std::uint32_t i_Type)
{
	VCameraController camera;
	camera.m_Type = i_Type;
	camera.SetSize(QSize(800, 600));
	camera.Update();
	return camera;
}

/// Turned and moved out of the way of the world's axes.
QMatrix4x4 SomeStart()
{
	QMatrix4x4 start;
	start.translate(300.0f, -200.0f, 900.0f);
	start.rotate(35.0f, 1.0f, 2.0f, -1.0f);
	return start;
}

/// Rotation about an axis through the origin, by Rodrigues' formula.
QVector3D Rotated(const QVector3D& i_rVector, const QVector3D& i_rAxis, double i_Angle)
{
	const auto s = static_cast<float>(std::sin(i_Angle)), c = static_cast<float>(std::cos(i_Angle));
	return c * i_rVector + s * QVector3D::crossProduct(i_rAxis, i_rVector)
	    + (1.0f - c) * QVector3D::dotProduct(i_rAxis, i_rVector) * i_rAxis;
}

QMatrix4x4 TurnedStart(std::uint32_t i_Axis, double i_Angle)
{
	const QMatrix4x4 start = SomeStart();
	const QVector3D axis = start.column(static_cast<int>(i_Axis)).toVector3D();
	QMatrix4x4 turned = start;
	for (int column = 0; column < 3; ++column)
		turned.setColumn(column, QVector4D(Rotated(start.column(column).toVector3D(), axis, i_Angle), 0.0f));
	return turned;
}

} // namespace

TEST(ManipulatorDrag, RaysGoThroughTheirPixels)
{
	for (std::uint32_t type = 0; type < CoreGraphics::ECameraTypeCount; ++type)
	{
		const VCameraController camera = MakeCamera(type);
		const std::optional<VMouseRay> ray = MakeMouseRay(camera, QPointF(123.0, 456.0));
		ASSERT_TRUE(ray);
		EXPECT_NEAR(ray->m_Direction.length(), 1.0f, 1e-6f);
		for (const float along : {2000.0f, 9000.0f})
		{
			const QPointF place = OnScreen(camera, ray->m_Origin + along * ray->m_Direction);
			EXPECT_NEAR(place.x(), 123.0, 0.05) << type;
			EXPECT_NEAR(place.y(), 456.0, 0.05) << type;
		}
	}
	VCameraController camera = MakeCamera(0);
	camera.SetSize(QSize(0, 0));
	EXPECT_FALSE(MakeMouseRay(camera, QPointF()));
}

TEST(ManipulatorDrag, PointsOfLinesAndPlanesUnderARay)
{
	const VMouseRay ray{QVector3D(10, 0, 5), QVector3D(0, 1, 0)};
	struct VRow
	{
		const char* m_pName;
		QVector3D m_Point, m_Direction;
		std::optional<QVector3D> m_OnLine, m_OnPlane;
	};
	const float s = std::sin(8 * c_Degree), c = std::cos(8 * c_Degree);
	const VRow rows[] = {{"crossing", {0, 100, 5}, {1, 0, 0}, QVector3D(10, 100, 5), {}},
	    {"passing", {0, 100, 0}, {1, 0, 0}, QVector3D(10, 100, 0), {}}, {"behind", {0, -100, 0}, {1, 0, 0}, {}, {}},
	    {"ahead, at right angles", {7, 50, 9}, {0, 1, 0}, {}, QVector3D(10, 50, 5)},
	    {"plane behind", {7, -50, 9}, {0, 1, 0}, {}, {}}, {"plane too far", {7, 90001, 9}, {0, 1, 0}, {}, {}},
	    {"farthest plane", {7, 90000, 9}, {0, 1, 0}, {}, QVector3D(10, 90000, 5)},
	    {"nearly parallel", {10, 100, 5}, {s, c, 0}, {}, QVector3D(10, 100, 5)}};
	for (const VRow& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		const auto expect = [](const std::optional<QVector3D>& i_rActual, const std::optional<QVector3D>& i_rExpected)
		{
			ASSERT_EQ(i_rActual.has_value(), i_rExpected.has_value());
			EXPECT_LT((i_rActual.value_or(QVector3D()) - i_rExpected.value_or(QVector3D())).length(), 1e-3f);
		};
		expect(PointOnLine(ray, rRow.m_Point, rRow.m_Direction), rRow.m_OnLine);
		expect(PointOnPlane(ray, rRow.m_Point, rRow.m_Direction), rRow.m_OnPlane);
	}
}

TEST(ManipulatorDrag, ArrowsMoveAlongTheirAxisWithTheMouse)
{
	// From above, 4 mm a pixel, with X to the left and Y down.
	const VCameraController camera = MakeCamera(CoreGraphics::ECameraTop);
	QMatrix4x4 start;
	start.translate(100.0f, 200.0f, 300.0f);
	struct VRow
	{
		std::uint32_t m_Axis;
		QPoint m_Move;
		QVector3D m_Expected;
	};
	for (const VRow& rRow : {VRow{0, {25, 7}, {-100, 0, 0}}, {0, {-25, 0}, {100, 0, 0}}, {1, {13, 30}, {0, 120, 0}}})
	{
		auto drag = VManipulatorDrag::Press(camera, {310, 390}, {EManipulatorArrow, rRow.m_Axis}, start);
		ASSERT_TRUE(drag);
		// Where the mouse went between is of no matter.
		drag->Drag(camera, {7, 9}, {});
		const auto moved = drag->Drag(camera, QPoint(310, 390) + rRow.m_Move, {});
		ASSERT_TRUE(moved);
		QMatrix4x4 expected = start;
		expected.translate(rRow.m_Expected);
		ExpectNear(*moved, expected, 1e-6f, 0.02f);
	}
	// The axis that points at the eye cannot be taken hold of.
	EXPECT_FALSE(VManipulatorDrag::Press(camera, {310, 390}, {EManipulatorArrow, 2}, start));
}

TEST(ManipulatorDrag, WhatIsMovedStaysUnderTheMouse)
{
	const VCameraController camera = MakeCamera(CoreGraphics::ECameraPerspective);
	const QMatrix4x4 start = SomeStart();
	const QVector3D centre = start.column(3).toVector3D();
	for (std::uint32_t axis = 0; axis < 3; ++axis)
	{
		SCOPED_TRACE(axis);
		const QVector3D direction = start.column(static_cast<int>(axis)).toVector3D();
		// An arrow taken at 80 mm and dragged to where 280 mm are seen; the mouse moves by whole pixels of 10 mm.
		const QPoint from = OnScreen(camera, centre + 80.0f * direction).toPoint();
		const QPoint to = OnScreen(camera, centre + 280.0f * direction).toPoint();
		auto drag = VManipulatorDrag::Press(camera, from, {EManipulatorArrow, axis}, start);
		ASSERT_TRUE(drag);
		// Where the mouse went between is of no matter.
		drag->Drag(camera, {7, 9}, {});
		const auto moved = drag->Drag(camera, to, {});
		ASSERT_TRUE(moved);
		const QVector3D way = moved->column(3).toVector3D() - centre;
		EXPECT_NEAR(QVector3D::crossProduct(way, direction).length(), 0.0f, 0.05f);
		EXPECT_NEAR(QVector3D::dotProduct(way, direction), 200.0f, 25.0f);

		// In the plane the point that was taken goes exactly where the mouse goes.
		const auto ray = MakeMouseRay(camera, from);
		const auto taken = PointOnPlane(*ray, centre, direction);
		ASSERT_TRUE(taken);
		drag = VManipulatorDrag::Press(camera, from, {EManipulatorPlane, axis}, start);
		const auto inPlane = drag->Drag(camera, from + QPoint(31, -17), {});
		ASSERT_TRUE(inPlane);
		const QVector3D wayInPlane = inPlane->column(3).toVector3D() - centre;
		EXPECT_NEAR(QVector3D::dotProduct(wayInPlane, direction), 0.0f, 0.05f);
		const QPointF place = OnScreen(camera, *taken + wayInPlane);
		EXPECT_NEAR(place.x(), from.x() + 31, 0.05);
		EXPECT_NEAR(place.y(), from.y() - 17, 0.05);
	}
}

TEST(ManipulatorDrag, RingsTurnByTheAngleAroundTheCentre)
{
	struct VRow
	{
		const char* m_pName;
		double m_Angle;
		Qt::KeyboardModifiers m_Modifiers;
		double m_Expected;
	};
	const VRow rows[] = {{"a little", 30, {}, 30}, {"the other way", -70, {}, -70},
	    {"more than half a turn", 250, {}, 250}, {"more than two turns", 800, {}, 800},
	    {"steps", 100, Qt::ControlModifier, 90}, {"to the next step", 113, Qt::ControlModifier, 135},
	    {"fine", 100, Qt::ShiftModifier, 20}, {"both give steps", 100, Qt::ControlModifier | Qt::ShiftModifier, 90}};
	for (const std::uint32_t type :
	    {CoreGraphics::ECameraPerspective, CoreGraphics::ECameraFront, CoreGraphics::ECameraTop})
	{
		const VCameraController camera = MakeCamera(type);
		const QPointF centre = OnScreen(camera, SomeStart().column(3).toVector3D());
		const QVector3D toEye = camera.Orientation().transposed().mapVector(QVector3D(0, 0, 1));
		for (std::uint32_t axis = 0; axis < 3; ++axis)
		{
			// An axis that points at the eye turns as the mouse does; the other way round it is seen from behind.
			const QVector3D direction = SomeStart().column(static_cast<int>(axis)).toVector3D();
			const double sign = QVector3D::dotProduct(direction, toEye) > 0.0f ? 1.0 : -1.0;
			for (const VRow& rRow : rows)
			{
				SCOPED_TRACE(testing::Message() << rRow.m_pName << ", axis " << axis << ", type " << type);
				// Far out, so that whole pixels are small parts of the angle.
				const auto at = [&](double i_Degrees)
				{
					const double angle = i_Degrees * M_PI / 180.0;
					return (centre + 20000.0 * QPointF(std::cos(angle), -std::sin(angle))).toPoint();
				};
				auto drag = VManipulatorDrag::Press(
				    camera, centre.toPoint() + QPoint(50, 0), {EManipulatorRing, axis}, SomeStart());
				ASSERT_TRUE(drag);
				drag->Drag(camera, at(0), {});
				for (int step = 1; step < 20; ++step)
					drag->Drag(camera, at(rRow.m_Angle * step / 20), {});
				const auto turned = drag->Drag(camera, at(rRow.m_Angle), rRow.m_Modifiers);
				ASSERT_TRUE(turned);
				ExpectNear(*turned, TurnedStart(axis, sign * rRow.m_Expected * M_PI / 180.0), 0.015f, 1e-3f);
			}
		}
	}
}

TEST(ManipulatorDrag, WhereThereIsNoAngleTheLastTransformHolds)
{
	VCameraController camera = MakeCamera(CoreGraphics::ECameraTop);
	auto drag = VManipulatorDrag::Press(camera, {450, 300}, {EManipulatorRing, 2}, QMatrix4x4());
	ASSERT_TRUE(drag);
	EXPECT_TRUE(drag->Drag(camera, {450, 250}, {}));
	EXPECT_FALSE(drag->Drag(camera, {400, 300}, {}));
	// The angle goes on from where it was: seen from above, a quarter turn against the clock.
	const auto turned = drag->Drag(camera, {400, 200}, {});
	ASSERT_TRUE(turned);
	ExpectNear(*turned, QMatrix4x4(0, -1, 0, 0, 1, 0, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1), 1e-5f, 1e-3f);

	// Behind the eye there is no angle either.
	camera.m_Type = CoreGraphics::ECameraPerspective;
	camera.m_Centre = camera.Orientation().transposed().mapVector(QVector3D(0, 0, -10000));
	camera.Update();
	EXPECT_FALSE(drag->Drag(camera, {100, 100}, {}));
	EXPECT_FALSE(VManipulatorDrag::Press(camera, {1, 1}, {EManipulatorMarker, 0}, QMatrix4x4()));
}
