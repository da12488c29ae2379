#pragma once

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectApplicationData.h"
#include "numerics/Rotation.h"

#include <QMatrix4x4>
#include <QVector3D>
#include <QVector4D>

#include <cstddef>
#include <optional>
#include <span>
#include <vector>

/// The shapes that a subject's segments and targets are drawn as. Millimetres.
namespace Flow2Graphics
{

/// Of the end sphere of a segment.
inline constexpr float c_SegmentRadius = 5.0f;
inline constexpr float c_JointRadius = 10.0f;
/// Edge of the box of a target.
inline constexpr float c_TargetEdge = 20.0f;
/// How thick a bone gets at most.
inline constexpr float c_BoneWidth = 150.0f;
/// Side and height of an origin plate.
inline constexpr float c_OriginSide = 75.0f;
inline constexpr float c_OriginHeight = 3.0f;

QMatrix4x4 ToMatrix(const Rotation::VPose<double>& i_rPose);
QVector3D ToVector(const Rotation::VVector3& i_rVector);
/// Each channel from 0 to 1.
QVector4D ToColour(const CoreOrlexTypes::VColour& i_rColour);
QVector3D Translation(const QMatrix4x4& i_rMatrix);

/// Of a segment that the application data is too short for: the default.
const CoreOrlexTypes::VSubjectApplicationData::VSegment& SegmentData(
    const CoreOrlexTypes::VSubjectApplicationData& i_rData, std::size_t i_Index);

/// The radius of each segment's end sphere: only visible segments that are no one's parent have one. A hidden child
/// does not give its parent one.
std::vector<float> SegmentRadii(
    const CoreOrlexTypes::VSubject& i_rSubject, const CoreOrlexTypes::VSubjectApplicationData& i_rData);

/// The segments with a plate at their origin: the root, and those that bear rigid bodies.
std::vector<bool> OriginSegments(const CoreOrlexTypes::VSubject& i_rSubject);

/// A bone of length 1 along Z from a segment's origin to the one of its child, turned about its axis so that its other
/// axes follow the parent's. Nothing for one that is shorter than a hundredth of a millimetre.
/// @param i_Twist about the bone, in degrees
std::optional<QMatrix4x4> BoneMatrix(const QMatrix4x4& i_rParent, const QVector3D& i_rChild, float i_Twist);

/// What takes the unit sphere to one standard deviation about a place.
/// @param i_rSegment the axes in which the covariance counts
/// @param i_Covariance 3x3, row by row, of which the upper triangle is read
/// @return nothing for another size, and for one that is not finite. Negative variances count as none.
std::optional<QMatrix4x4> CovarianceMatrix(
    const QMatrix4x4& i_rSegment, const QVector3D& i_rPlace, std::span<const double> i_Covariance);

/// What takes the cylinder of radius 1 and height 1 along Z to a stick.
QMatrix4x4 StickMatrix(const QVector3D& i_rFrom, const QVector3D& i_rTo, float i_Radius);

} // namespace Flow2Graphics
