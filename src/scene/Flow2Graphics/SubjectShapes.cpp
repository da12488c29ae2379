#include "Flow2Graphics/SubjectShapes.h"

#include "numerics/AllFinite.h"
#include "numerics/fnl_symmetric_eigensystem.h"

#include <algorithm>
#include <array>
#include <cmath>

using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectApplicationData;

namespace Flow2Graphics
{

namespace
{

constexpr float c_ShortestBone = 0.01f;
/// Most bones lie along an axis, at right angles to two others: rounding must not choose between them.
constexpr float c_Tie = 1e-4f;

/// The axis of a matrix that is furthest from a direction.
QVector3D FurthestAxis(const QMatrix4x4& i_rMatrix, const QVector3D& i_rDirection)
{
	QVector3D furthest;
	float smallest = 2.0f;
	for (int axis = 0; axis < 3; ++axis)
	{
		const QVector3D column = i_rMatrix.column(axis).toVector3D();
		if (const float along = std::abs(QVector3D::dotProduct(column, i_rDirection)); along < smallest - c_Tie)
		{
			smallest = along;
			furthest = column;
		}
	}
	return furthest;
}

/// Z along a direction of length 1, X across it and an axis, all of length 1.
QMatrix4x4 AlongZ(const QVector3D& i_rAxis, const QVector3D& i_rDirection, const QVector3D& i_rOrigin)
{
	const QVector3D x = QVector3D::crossProduct(i_rAxis, i_rDirection).normalized();
	const QVector3D y = QVector3D::crossProduct(i_rDirection, x);
	QMatrix4x4 matrix;
	matrix.setColumn(0, QVector4D(x, 0.0f));
	matrix.setColumn(1, QVector4D(y, 0.0f));
	matrix.setColumn(2, QVector4D(i_rDirection, 0.0f));
	matrix.setColumn(3, QVector4D(i_rOrigin, 1.0f));
	return matrix;
}

} // namespace

QMatrix4x4 ToMatrix(const Rotation::VPose<double>& i_rPose)
{
	const auto& R = i_rPose.R;
	const auto f = [](double i_Value) { return static_cast<float>(i_Value); };
	return QMatrix4x4(f(R[0]), f(R[1]), f(R[2]), f(i_rPose.t[0]), f(R[3]), f(R[4]), f(R[5]), f(i_rPose.t[1]), f(R[6]),
	    f(R[7]), f(R[8]), f(i_rPose.t[2]), 0.0f, 0.0f, 0.0f, 1.0f);
}

QVector3D ToVector(const Rotation::VVector3& i_rVector)
{
	return {static_cast<float>(i_rVector[0]), static_cast<float>(i_rVector[1]), static_cast<float>(i_rVector[2])};
}

QVector4D ToColour(const CoreOrlexTypes::VColour& i_rColour)
{
	constexpr float c_Part = 0.003921569f;
	return QVector4D(i_rColour.m_Red, i_rColour.m_Green, i_rColour.m_Blue, i_rColour.m_Alpha) * c_Part;
}

QVector3D Translation(const QMatrix4x4& i_rMatrix)
{
	return i_rMatrix.column(3).toVector3D();
}

const VSubjectApplicationData::VSegment& SegmentData(const VSubjectApplicationData& i_rData, std::size_t i_Index)
{
	static const VSubjectApplicationData::VSegment s_Default;
	return i_Index < i_rData.m_Segments.size() ? i_rData.m_Segments[i_Index] : s_Default;
}

std::vector<float> SegmentRadii(const VSubject& i_rSubject, const VSubjectApplicationData& i_rData)
{
	std::vector<float> radii(i_rSubject.m_Segments.size(), c_SegmentRadius);
	for (std::size_t i = 0; i < radii.size(); ++i)
	{
		if (!SegmentData(i_rData, i).m_Visible)
			radii[i] = 0.0f;
		if (const std::uint32_t parent = i_rSubject.m_Segments[i].m_ParentSegmentIndex; parent < radii.size())
			radii[parent] = 0.0f;
	}
	return radii;
}

std::vector<bool> OriginSegments(const VSubject& i_rSubject)
{
	std::vector<bool> origins(i_rSubject.m_Segments.size());
	if (!origins.empty())
		origins[0] = true;
	for (const VSubject::VTarget& rTarget : i_rSubject.m_Targets)
		if (rTarget.m_Type == VSubject::VTarget::ERigidBody)
			for (const std::uint32_t segment : rTarget.m_SegmentIndices)
				if (segment < origins.size())
					origins[segment] = true;
	return origins;
}

std::optional<QMatrix4x4> BoneMatrix(const QMatrix4x4& i_rParent, const QVector3D& i_rChild, float i_Twist)
{
	const QVector3D origin = Translation(i_rParent);
	const float length = (i_rChild - origin).length();
	if (!(length >= c_ShortestBone))
		return {};
	const QVector3D z = (i_rChild - origin) / length;
	QMatrix4x4 matrix = AlongZ(FurthestAxis(i_rParent, z), z, origin);
	const float width = std::min(length, c_BoneWidth);
	matrix.scale(width, width, length);
	if (i_Twist != 0.0f)
		matrix.rotate(i_Twist, 0.0f, 0.0f, 1.0f);
	return matrix;
}

std::optional<QMatrix4x4> CovarianceMatrix(
    const QMatrix4x4& i_rSegment, const QVector3D& i_rPlace, std::span<const double> i_Covariance)
{
	std::array<double, 9> covariance;
	if (i_Covariance.size() != covariance.size() || !AllFinite(i_Covariance))
		return {};
	std::copy(i_Covariance.begin(), i_Covariance.end(), covariance.begin());
	const fnl_symmetric_eigensystem<3> system(covariance);
	QMatrix4x4 axes;
	for (int axis = 0; axis < 3; ++axis)
	{
		const double* const pVector = &system.Vectors()[3 * static_cast<std::size_t>(axis)];
		const double deviation = std::sqrt(std::max(system.Values()[static_cast<std::size_t>(axis)], 0.0));
		axes.setColumn(axis,
		    QVector4D(static_cast<float>(pVector[0] * deviation), static_cast<float>(pVector[1] * deviation),
		        static_cast<float>(pVector[2] * deviation), 0.0f));
	}
	// A mirrored sphere would be drawn inside out.
	if (axes.determinant() < 0.0f)
		axes.setColumn(0, -axes.column(0));
	QMatrix4x4 matrix = i_rSegment;
	matrix.setColumn(3, QVector4D(i_rPlace, 1.0f));
	return matrix * axes;
}

QMatrix4x4 StickMatrix(const QVector3D& i_rFrom, const QVector3D& i_rTo, float i_Radius)
{
	const float length = (i_rTo - i_rFrom).length();
	const QVector3D z = length > 0.0f ? (i_rTo - i_rFrom) / length : QVector3D(0.0f, 0.0f, 1.0f);
	QMatrix4x4 matrix = AlongZ(FurthestAxis(QMatrix4x4(), z), z, i_rFrom);
	matrix.scale(i_Radius, i_Radius, length);
	return matrix;
}

} // namespace Flow2Graphics
