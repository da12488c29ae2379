#pragma once

#include "fbxsdk/scene/ArraySource.h"
#include "fbxsdk/sdk/AffineMatrix.h"

#include <algorithm>

namespace fbxsdk
{

class FbxSurfaceMaterial;

/// How an entry of an array is kept: as the numbers of the file, so that they are decoded straight to where they stay.
template <typename T>
struct FbxLayerElementEntry;

template <>
struct FbxLayerElementEntry<FbxVector4>
{
	using VNumber = double;
	static constexpr std::size_t c_Size = 3;
	static FbxVector4 Make(const double* i_p) { return {i_p[0], i_p[1], i_p[2]}; }
};

template <>
struct FbxLayerElementEntry<FbxVector2>
{
	using VNumber = double;
	static constexpr std::size_t c_Size = 2;
	static FbxVector2 Make(const double* i_p) { return {i_p[0], i_p[1]}; }
};

template <>
struct FbxLayerElementEntry<int>
{
	using VNumber = std::int32_t;
	static constexpr std::size_t c_Size = 1;
	static int Make(const std::int32_t* i_p) { return *i_p; }
};

class FbxLayerElementArray
{
public:
	int GetCount() const { return m_Count; }

protected:
	int m_Count = 0;
};

template <typename T>
class FbxLayerElementArrayTemplate : public FbxLayerElementArray
{
public:
	/// Zeros beyond the end.
	T GetAt(int pIndex) const
	{
		using VEntry = FbxLayerElementEntry<T>;
		return pIndex >= 0 && pIndex < m_Count ? VEntry::Make(m_Numbers.data() + VEntry::c_Size * pIndex) : T();
	}

private:
	template <typename TOther>
	friend class FbxLayerElementTemplate;

	FbxFormat::VArrayNumbers<typename FbxLayerElementEntry<T>::VNumber>& Numbers() { return m_Numbers; }
	void Count() { m_Count = int(m_Numbers.size() / FbxLayerElementEntry<T>::c_Size); }

	FbxFormat::VArrayNumbers<typename FbxLayerElementEntry<T>::VNumber> m_Numbers;
};

class FbxLayerElement
{
public:
	enum EType
	{
		eUnknown,
		eNormal,
		eMaterial = 4,
		eUV = 8
	};

	enum EMappingMode
	{
		eNone,
		eByControlPoint,
		eByPolygonVertex,
		eByPolygon,
		eByEdge,
		eAllSame
	};

	enum EReferenceMode
	{
		eDirect,
		eIndex,
		eIndexToDirect
	};

	EMappingMode GetMappingMode() const { return m_MappingMode; }
	EReferenceMode GetReferenceMode() const { return m_ReferenceMode; }

protected:
	FbxLayerElement() = default;
	/// From the record of a layer element.
	explicit FbxLayerElement(const FbxFormat::VArraySource& i_rRecord);

	EMappingMode m_MappingMode = eNone;
	EReferenceMode m_ReferenceMode = eDirect;
};

/// Values of a mesh. Each of the two arrays is decoded when it is asked for.
template <typename T>
class FbxLayerElementTemplate : public FbxLayerElement
{
public:
	FbxLayerElementArrayTemplate<T>& GetDirectArray() const { return Loaded(m_Direct, m_DirectSource); }
	FbxLayerElementArrayTemplate<int>& GetIndexArray() const { return Loaded(m_Index, m_IndexSource); }

private:
	friend class FbxGeometryBase;
	friend class FbxMesh;

	/// Of these numbers, one entry for each control point.
	explicit FbxLayerElementTemplate(FbxFormat::VArrayNumbers<typename FbxLayerElementEntry<T>::VNumber> i_Numbers)
	{
		m_MappingMode = eByControlPoint;
		m_Direct.Numbers() = std::move(i_Numbers);
		m_Direct.Count();
	}

	FbxLayerElementTemplate(
	    const FbxFormat::VArraySource& i_rRecord, const char* i_pDirect, const char* i_pIndex, std::string i_Owner)
	    : FbxLayerElement(i_rRecord), m_Owner(std::move(i_Owner)), m_DirectSource(i_rRecord.Child(i_pDirect)),
	      m_IndexSource(i_rRecord.Child(i_pIndex))
	{
	}

	template <typename TArray>
	TArray& Loaded(TArray& io_rArray, FbxFormat::VArraySource& io_rSource) const
	{
		if (io_rSource.m_Element != FbxFormat::c_NoElement)
		{
			FbxFormat::Decode({io_rSource, m_Owner.c_str(), &io_rArray.Numbers()});
			io_rArray.Count();
			io_rSource.m_Element = FbxFormat::c_NoElement;
		}
		return io_rArray;
	}

	/// For decoding both arrays, as far as a mapping by points or polygon vertices needs them, together with others.
	void AddJobs(std::vector<FbxFormat::VDecodeJob>& io_rJobs) const
	{
		if (m_MappingMode == eByControlPoint || m_MappingMode == eByPolygonVertex)
			io_rJobs.push_back({m_DirectSource, m_Owner.c_str(), &m_Direct.Numbers()});
		if (m_MappingMode == eByPolygonVertex && m_ReferenceMode != eDirect)
			io_rJobs.push_back({m_IndexSource, m_Owner.c_str(), &m_Index.Numbers()});
	}

	/// After them.
	void EndJobs() const
	{
		if (m_MappingMode == eByControlPoint || m_MappingMode == eByPolygonVertex)
			m_DirectSource.m_Element = FbxFormat::c_NoElement;
		if (m_MappingMode == eByPolygonVertex && m_ReferenceMode != eDirect)
			m_IndexSource.m_Element = FbxFormat::c_NoElement;
		m_Direct.Count();
		m_Index.Count();
	}

	std::string m_Owner;
	mutable FbxFormat::VArraySource m_DirectSource;
	mutable FbxFormat::VArraySource m_IndexSource;
	mutable FbxLayerElementArrayTemplate<T> m_Direct;
	mutable FbxLayerElementArrayTemplate<int> m_Index;
};

using FbxLayerElementNormal = FbxLayerElementTemplate<FbxVector4>;
using FbxLayerElementUV = FbxLayerElementTemplate<FbxVector2>;
/// Its index array holds the places among the node's materials.
using FbxLayerElementMaterial = FbxLayerElementTemplate<int>;
using FbxGeometryElementNormal = FbxLayerElementNormal;
using FbxGeometryElementUV = FbxLayerElementUV;
using FbxGeometryElementMaterial = FbxLayerElementMaterial;

} // namespace fbxsdk
