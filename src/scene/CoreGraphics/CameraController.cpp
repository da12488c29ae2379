#include "CoreGraphics/CameraController.h"

#include "CoreGraphics/InteractionMapper.h"
#include "CoreGraphics/RenderContext.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>

namespace CoreGraphics
{

namespace
{

// Half a degree in radians.
constexpr float c_HalfDegree = 0.008726646f;
// Space round what is fitted, in millimetres.
constexpr float c_FitMargin = 250.0f;

constexpr QVector3D c_XAxis(1.0f, 0.0f, 0.0f);
constexpr QVector3D c_YAxis(0.0f, 1.0f, 0.0f);
constexpr QVector3D c_ZAxis(0.0f, 0.0f, 1.0f);

bool IsFinite(const QVector4D& i_rSphere)
{
	return std::isfinite(i_rSphere.x()) && std::isfinite(i_rSphere.y()) && std::isfinite(i_rSphere.z())
	    && std::isfinite(i_rSphere.w());
}

} // namespace

VCameraController::~VCameraController() = default;

QMatrix4x4 VCameraController::Orientation() const
{
	QMatrix4x4 orientation;
	if (!IsOrthographic())
	{
		orientation.rotate(m_Pitch, c_XAxis);
		orientation.rotate(m_Yaw, c_ZAxis);
		if (m_bYUp)
			orientation.rotate(90.0f, c_XAxis);
		return orientation;
	}
	switch (m_Type)
	{
	case ECameraBack: orientation.rotate(180.0f, c_YAxis); break;
	case ECameraLeft: orientation.rotate(-90.0f, c_YAxis); break;
	case ECameraRight: orientation.rotate(90.0f, c_YAxis); break;
	case ECameraTop: orientation.rotate(90.0f, c_XAxis); break;
	case ECameraBottom: orientation.rotate(-90.0f, c_XAxis); break;
	default: break;
	}
	if (!m_bYUp)
	{
		orientation.rotate(-90.0f, c_XAxis);
		orientation.rotate(180.0f, c_ZAxis);
	}
	return orientation;
}

void VCameraController::Update()
{
	m_View.setToIdentity();
	m_View.translate(0.0f, 0.0f, IsOrthographic() ? -0.5f * m_Far : -m_Distance);
	m_View *= Orientation();
	m_View.translate(-m_Centre);
	m_View *= m_FrameOfReference.inverted();
	UpdateProjection();
}

void VCameraController::UpdateProjection()
{
	const auto width = static_cast<float>(m_Size.width());
	const auto height = static_cast<float>(m_Size.height());
	m_Projection.setToIdentity();
	if (IsOrthographic())
	{
		const float halfWidth = 0.5f * width * m_OrthographicScale;
		const float halfHeight = 0.5f * height * m_OrthographicScale;
		m_Projection.ortho(-halfWidth, halfWidth, -halfHeight, halfHeight, m_Near, m_Far);
	}
	else
		m_Projection.perspective(m_FieldOfView, width / std::max(height, 1.0f), m_Near, m_Far);
}

void VCameraController::SetSize(const QSize& i_rSize)
{
	m_Size = i_rSize;
	UpdateProjection();
}

void VCameraController::SetDistance(float i_Distance)
{
	m_Distance = std::clamp(i_Distance, c_MinimumDistance, c_MaximumDistance);
}

void VCameraController::SetScale(float i_Scale)
{
	m_OrthographicScale = std::clamp(i_Scale, c_MinimumScale, c_MaximumScale);
}

void VCameraController::Reset(bool i_bClose)
{
	m_Pitch = i_bClose ? -90.0f : -60.0f;
	m_Yaw = i_bClose ? 0.0f : 45.0f;
	m_Distance = i_bClose ? 1000.0f : 7000.0f;
	m_OrthographicScale = 4.0f;
	m_Centre = {};
	m_FrameOfReference.setToIdentity();
}

void VCameraController::Fit(const std::vector<QVector4D>& i_rBounds, bool i_bAdjust)
{
	std::vector<QVector4D> spheres;
	std::copy_if(i_rBounds.begin(), i_rBounds.end(), std::back_inserter(spheres), IsFinite);
	if (spheres.empty())
		return;

	constexpr float infinity = std::numeric_limits<float>::infinity();
	QVector3D low(infinity, infinity, infinity), high = -low;
	for (const QVector4D& rSphere : spheres)
	{
		for (int axis = 0; axis < 3; ++axis)
		{
			low[axis] = std::min(low[axis], rSphere[axis] - rSphere.w());
			high[axis] = std::max(high[axis], rSphere[axis] + rSphere.w());
		}
	}
	m_Centre = 0.5f * (low + high);
	if (!i_bAdjust || m_Size.isEmpty())
		return;

	const auto width = static_cast<float>(m_Size.width());
	const auto height = static_cast<float>(m_Size.height());
	const QMatrix4x4 orientation = Orientation();
	if (IsOrthographic())
	{
		float halfWidth = 0.0f, halfHeight = 0.0f;
		for (const QVector4D& rSphere : spheres)
		{
			const QVector3D offset = orientation.mapVector(rSphere.toVector3D() - m_Centre);
			halfWidth = std::max(halfWidth, std::abs(offset.x()) + rSphere.w() + c_FitMargin);
			halfHeight = std::max(halfHeight, std::abs(offset.y()) + rSphere.w() + c_FitMargin);
		}
		SetScale(std::max(2.0f * halfWidth / width, 2.0f * halfHeight / height));
	}
	else
	{
		// Outward normals of the frustum's planes in the space of the eye, which looks along -Z.
		const float up = m_FieldOfView * c_HalfDegree;
		const float side = std::atan(std::tan(up) * width / height);
		const std::array<QVector3D, 4> normals = {
		    {{0.0f, std::cos(up), std::sin(up)}, {0.0f, -std::cos(up), std::sin(up)},
		        {std::cos(side), 0.0f, std::sin(side)}, {-std::cos(side), 0.0f, std::sin(side)}}};
		float distance = 0.0f;
		for (const QVector4D& rSphere : spheres)
		{
			const QVector3D offset = orientation.mapVector(rSphere.toVector3D() - m_Centre);
			for (const QVector3D& rNormal : normals)
				distance = std::max(
				    distance, (QVector3D::dotProduct(offset, rNormal) + rSphere.w() + c_FitMargin) / rNormal.z());
		}
		SetDistance(distance);
	}
	UpdateProjection();
}

void VCameraController::SetActions(std::uint32_t i_Buttons, std::uint32_t i_Modifiers)
{
	m_bTranslate = VInteractionMapper::Test(EInteractionPan, i_Buttons, i_Modifiers);
	// Fixed views do not turn.
	m_bRotate = !IsOrthographic() && VInteractionMapper::Test(EInteractionOrbit, i_Buttons, i_Modifiers);
	m_bDolly = VInteractionMapper::Test(EInteractionDolly, i_Buttons, i_Modifiers);
}

void VCameraController::Press(const QPoint& i_rMouse, std::uint32_t i_Buttons, std::uint32_t i_Modifiers)
{
	if (!m_bTranslate && !m_bRotate && !m_bDolly)
		m_LastMouse = i_rMouse;
	SetActions(i_Buttons, i_Modifiers);
}

void VCameraController::Release(std::uint32_t i_Buttons, std::uint32_t i_Modifiers)
{
	SetActions(i_Buttons, i_Modifiers);
}

void VCameraController::Move(const QPoint& i_rMouse)
{
	const auto dx = static_cast<float>(m_LastMouse.x() - i_rMouse.x());
	const auto dy = static_cast<float>(m_LastMouse.y() - i_rMouse.y());
	m_LastMouse = i_rMouse;
	if (m_bTranslate)
	{
		const float millimetres = IsOrthographic() ? m_OrthographicScale
		                                           : 2.0f * std::tan(m_FieldOfView * c_HalfDegree) * m_Distance
		        / static_cast<float>(std::max(m_Size.height(), 1));
		m_Centre += millimetres * Orientation().transposed().mapVector(QVector3D(dx, -dy, 0.0f));
	}
	if (m_bRotate)
	{
		m_Yaw -= 0.2f * dx;
		m_Pitch -= 0.2f * dy;
	}
	if (m_bDolly)
	{
		if (IsOrthographic())
		{
			SetScale(m_OrthographicScale * (1.0f - 0.0025f * dy));
			UpdateProjection();
		}
		else
			SetDistance(m_Distance - 15.0f * dy);
	}
}

void VCameraController::Wheel(int i_Delta, bool i_bInFixedViews)
{
	const float factor = i_Delta < 0 ? 1.1f : 0.9f;
	if (!IsOrthographic() || !i_bInFixedViews)
		return SetDistance(m_Distance * factor);
	SetScale(m_OrthographicScale * factor);
	UpdateProjection();
}

void VCameraController::Apply(VRenderContext& io_rContext) const
{
	io_rContext.m_Projection = m_Projection;
	io_rContext.m_View = m_View;
	io_rContext.m_FrameSize = m_Size;
	io_rContext.SetViewport(QRect(QPoint(0, 0), m_Size));
}

} // namespace CoreGraphics
