#pragma once

#include <QMatrix4x4>
#include <QVector3D>
#include <QVector4D>

#include <array>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <span>
#include <string>
#include <vector>

namespace CoreGraphics
{

class VSkin;

/// A skin on the segments of one subject: bones go with the segments of their names, scaled so that a skin made for
/// other proportions fits. Render thread; touches no OpenGL.
class VSkinInstance
{
public:
	/// A matrix column by column, as OpenGL takes it.
	using VBoneMatrix = std::array<float, 16>;

	/// Without a skeleton, or with names and offsets of different counts, nothing changes. What of the skin will not be
	/// where the segments are is told in the log.
	/// @param i_rOffsets of each segment in its parent, in millimetres
	void Bind(std::shared_ptr<VSkin> i_pSkin, const std::vector<std::string>& i_rNames,
	    const std::vector<QVector3D>& i_rOffsets);

	/// @param i_Poses of the segments in the world, rotations and translations; segments that it does not have keep
	/// theirs
	void UpdatePose(std::span<const QMatrix4x4> i_Poses);

	/// In alpha how much they cover the skin's own colour.
	void SetUserColours(const QVector4D& i_rA, const QVector4D& i_rB);
	/// Shows with the next pose.
	/// @param i_Value 1 for a healthy segment, 0 for one whose skin is red
	void SetHealth(std::size_t i_Segment, float i_Value);

	/// Null before it was bound.
	const std::shared_ptr<VSkin>& GetSkin() const { return m_pSkin; }
	const QVector4D& UserColourA() const { return m_UserColourA; }
	const QVector4D& UserColourB() const { return m_UserColourB; }
	/// From where the skin was made to where it is, by bone; element (3, 3) is the segment's health.
	std::span<const VBoneMatrix> BoneMatrices() const { return m_BoneMatrices; }

	/// Bone of each segment, -1 for none.
	std::span<const std::int64_t> SegmentToBone() const { return m_SegmentToBone; }
	/// Bones that no segment drives, in their order.
	std::span<const std::size_t> UnmappedBones() const { return m_UnmappedBones; }
	std::span<const QVector3D> BoneScales() const { return m_BoneScales; }

private:
	/// What a bone's matrix is made of: the pose of a segment, then a matrix that stays.
	struct VDriver
	{
		/// -1 for a bone that stays where it is.
		std::int64_t m_Segment = -1;
		VBoneMatrix m_Offset{};
	};

	/// @return bone of each segment
	void MapBones(const std::vector<std::string>& i_rNames, const std::vector<QVector3D>& i_rOffsets);
	void UnifyScales(float i_Least, float i_Most);
	void MakeDrivers();
	void WarnOfMismatches() const;

	std::shared_ptr<VSkin> m_pSkin;
	std::vector<VBoneMatrix> m_BoneMatrices;
	QVector4D m_UserColourA;
	QVector4D m_UserColourB;
	std::vector<std::int64_t> m_SegmentToBone;
	std::vector<std::size_t> m_UnmappedBones;
	std::vector<QVector3D> m_BoneScales;
	std::vector<float> m_SegmentHealth;
	std::vector<VDriver> m_Drivers;
};

} // namespace CoreGraphics
