#include "CoreGraphics/SkinInstance.h"

#include "CoreGraphics/QtForm.h"
#include "CoreGraphics/Skin.h"
#include "DebugServices/GlobalLog.h"

#include <boost/format.hpp>

#include <algorithm>
#include <limits>
#include <unordered_map>

namespace CoreGraphics
{

namespace
{

/// Millimetres; what is shorter has no direction.
constexpr float c_NoLength = 0.00001f;
/// Below it the proportions of subject and skin are the same.
constexpr float c_SameScale = 0.01f;
/// As many bones are named in a message.
constexpr std::size_t c_MaxNames = 5;

/// Lower case, without a namespace.
std::string NormaliseName(const std::string& i_rName)
{
	std::string name = i_rName.substr(i_rName.rfind(':') + 1);
	for (char& rCharacter : name)
		if (rCharacter >= 'A' && rCharacter <= 'Z')
			rCharacter = static_cast<char>(rCharacter - 'A' + 'a');
	return name;
}

VSkinInstance::VBoneMatrix ToColumns(const QMatrix4x4& i_rMatrix)
{
	VSkinInstance::VBoneMatrix columns;
	std::copy_n(i_rMatrix.constData(), columns.size(), columns.begin());
	return columns;
}

/// a * b, where the last row of both is 0, 0, 0, 1.
void Multiply(const float* i_pA, const VSkinInstance::VBoneMatrix& i_rB, VSkinInstance::VBoneMatrix& o_rProduct)
{
	for (std::size_t column = 0; column < 16; column += 4)
		for (std::size_t row = 0; row < 4; ++row)
			o_rProduct[column + row] = i_pA[row] * i_rB[column] + i_pA[4 + row] * i_rB[column + 1]
			    + i_pA[8 + row] * i_rB[column + 2] + i_pA[12 + row] * i_rB[column + 3];
}

} // namespace

void VSkinInstance::Bind(
    std::shared_ptr<VSkin> i_pSkin, const std::vector<std::string>& i_rNames, const std::vector<QVector3D>& i_rOffsets)
{
	if (!i_pSkin || !i_pSkin->Skeleton() || i_rNames.size() != i_rOffsets.size())
		return;
	m_pSkin = std::move(i_pSkin);
	const std::size_t bones = m_pSkin->Skeleton()->size();
	m_SegmentHealth.assign(i_rNames.size(), 1.0f);
	m_SegmentToBone.clear();
	m_SegmentToBone.reserve(i_rNames.size());
	m_BoneScales.assign(bones, QVector3D(1.0f, 1.0f, 1.0f));
	m_UnmappedBones.clear();
	// A rigid object is as large as it is, whatever the names.
	if (i_rNames.size() == 1 && bones == 1)
		m_SegmentToBone.push_back(0);
	else
		MapBones(i_rNames, i_rOffsets);
	MakeDrivers();
	WarnOfMismatches();
}

void VSkinInstance::MapBones(const std::vector<std::string>& i_rNames, const std::vector<QVector3D>& i_rOffsets)
{
	const FBXIO::VSkinSkeleton& rSkeleton = *m_pSkin->Skeleton();
	// Of bones of one name the last is the one that vertices are bound to.
	std::unordered_map<std::string, std::size_t> boneOfName;
	for (std::size_t i = 0; i < rSkeleton.size(); ++i)
		boneOfName[NormaliseName(rSkeleton[i].m_Name)] = i;

	float least = std::numeric_limits<float>::max();
	float most = std::numeric_limits<float>::lowest();
	std::vector<float> longest(rSkeleton.size(), 0.0f);
	std::vector<bool> mapped(rSkeleton.size(), false);
	for (std::size_t i = 0; i < i_rNames.size(); ++i)
	{
		const auto found = boneOfName.find(NormaliseName(i_rNames[i]));
		if (found == boneOfName.end())
		{
			m_SegmentToBone.push_back(-1);
			continue;
		}
		const FBXIO::VSkinBone& rBone = rSkeleton[found->second];
		m_SegmentToBone.push_back(static_cast<std::int64_t>(found->second));
		mapped[found->second] = true;
		boneOfName.erase(found);
		if (rBone.m_ParentIndex < 0 || i_rNames.size() < 3)
			continue;
		// The longest of a bone's children tells how much longer the subject's is.
		const auto parent = static_cast<std::size_t>(rBone.m_ParentIndex);
		const float length = ToQt(rBone.m_Local.Translation()).length() * rSkeleton[parent].m_AccumulatedScale;
		const float wanted = i_rOffsets[i].length();
		if (length > c_NoLength && wanted > c_NoLength && length > longest[parent])
		{
			longest[parent] = length;
			const float ratio = wanted / length;
			least = std::min(least, ratio);
			most = std::max(most, ratio);
			for (int k = 0; k < 3; ++k)
				m_BoneScales[parent][k] = i_rOffsets[i][k] != 0.0f ? ratio : 1.0f;
		}
	}
	for (std::size_t i = 0; i < mapped.size(); ++i)
		if (!mapped[i])
			m_UnmappedBones.push_back(i);
	UnifyScales(least, most);
}

void VSkinInstance::UnifyScales(float i_Least, float i_Most)
{
	NVX_LOG("CoreGraphics", NVX::ELogDetail, "Bone scales");
	const float range = i_Most - i_Least;
	if (i_Least != std::numeric_limits<float>::max() && range < c_SameScale)
	{
		const float scale = range * 0.5f + i_Least;
		std::fill(m_BoneScales.begin(), m_BoneScales.end(), QVector3D(scale, scale, scale));
		NVX_LOG("CoreGraphics", NVX::ELogDetail, "Global scale: %1%", scale);
		return;
	}
	for (std::size_t i = 0; i < m_BoneScales.size(); ++i)
	{
		const std::string& rName = (*m_pSkin->Skeleton())[i].m_Name;
		QVector3D& rScale = m_BoneScales[i];
		if (i == 0 || rName.find("Foot") != std::string::npos)
			rScale = QVector3D(1.0f, 1.0f, 1.0f);
		NVX_LOG("CoreGraphics", NVX::ELogDetail, "%1% : (%2%, %3%, %4%) ", rName, rScale.x(), rScale.y(), rScale.z());
	}
}

void VSkinInstance::MakeDrivers()
{
	const FBXIO::VSkinSkeleton& rSkeleton = *m_pSkin->Skeleton();
	m_Drivers.assign(rSkeleton.size(), {});
	// Of each bone within its segment; of one that has none within that of the nearest bone above it that has.
	std::vector<QMatrix4x4> places(rSkeleton.size());
	for (std::size_t i = 0; i < m_SegmentToBone.size(); ++i)
		if (const auto bone = static_cast<std::size_t>(m_SegmentToBone[i]); bone < rSkeleton.size())
		{
			m_Drivers[bone].m_Segment = static_cast<std::int64_t>(i);
			places[bone].scale(rSkeleton[bone].m_AccumulatedScale);
			places[bone].scale(m_BoneScales[bone]);
		}
	// Parents stand before their children.
	for (const std::size_t bone : m_UnmappedBones)
	{
		places[bone] = ToQt(rSkeleton[bone].m_Local);
		if (const auto parent = static_cast<std::size_t>(rSkeleton[bone].m_ParentIndex); parent < bone)
		{
			m_Drivers[bone].m_Segment = m_Drivers[parent].m_Segment;
			places[bone] = places[parent] * places[bone];
		}
	}
	m_BoneMatrices.resize(rSkeleton.size());
	for (std::size_t i = 0; i < rSkeleton.size(); ++i)
	{
		m_Drivers[i].m_Offset = ToColumns(places[i] * ToQt(rSkeleton[i].m_InverseBind));
		m_BoneMatrices[i] = m_Drivers[i].m_Offset;
	}
}

void VSkinInstance::WarnOfMismatches() const
{
	// The one without meshes was told of when it was read.
	if (m_pSkin->Meshes().empty())
		return;
	const FBXIO::VSkinSkeleton& rSkeleton = *m_pSkin->Skeleton();
	if (std::all_of(m_SegmentToBone.begin(), m_SegmentToBone.end(), [](std::int64_t i_Bone) { return i_Bone < 0; }))
		m_pSkin->WarnOnce(
		    (boost::format("No bone of the skin %1% has the name of a segment: it stays where it was made")
		        % m_pSkin->Name())
		        .str());

	// A bone without a segment stands as its local matrix has it, which leaves out the pre-rotation; what hangs on it
	// turns, too.
	std::vector<bool> turns(rSkeleton.size(), false);
	std::string names;
	std::size_t count = 0;
	for (const std::size_t bone : m_UnmappedBones)
	{
		const auto parent = static_cast<std::size_t>(rSkeleton[bone].m_ParentIndex);
		turns[bone] =
		    !qFuzzyCompare(ToQt(rSkeleton[bone].m_PreRotation), QMatrix4x4()) || (parent < bone && turns[parent]);
		if (!turns[bone] || !m_pSkin->MovesVertices(bone))
			continue;
		if (++count <= c_MaxNames)
			names += (count > 1 ? ", " : "") + rSkeleton[bone].m_Name;
	}
	if (count > 0)
		m_pSkin->WarnOnce((boost::format("The skin %1% may be shown twisted at bones that no segment drives and that "
		                                 "have pre-rotations, or hang on such: %2%%3%")
		    % m_pSkin->Name() % names % (count > c_MaxNames ? "..." : ""))
		                      .str());
}

void VSkinInstance::UpdatePose(std::span<const QMatrix4x4> i_Poses)
{
	for (std::size_t i = 0; i < m_Drivers.size(); ++i)
		if (const auto segment = static_cast<std::size_t>(m_Drivers[i].m_Segment); segment < i_Poses.size())
			Multiply(i_Poses[segment].constData(), m_Drivers[i].m_Offset, m_BoneMatrices[i]);
	for (std::size_t i = 0; i < m_SegmentToBone.size(); ++i)
		if (const auto bone = static_cast<std::size_t>(m_SegmentToBone[i]); bone < m_BoneMatrices.size())
			m_BoneMatrices[bone].back() = m_SegmentHealth[i];
}

void VSkinInstance::SetUserColours(const QVector4D& i_rA, const QVector4D& i_rB)
{
	m_UserColourA = i_rA;
	m_UserColourB = i_rB;
}

void VSkinInstance::SetHealth(std::size_t i_Segment, float i_Value)
{
	if (i_Segment < m_SegmentHealth.size())
		m_SegmentHealth[i_Segment] = i_Value;
}

} // namespace CoreGraphics
