#pragma once

#include "fbxsdk/sdk/Object.h"

#include <vector>

namespace FbxFormat
{
class VMaterialReader;
}

namespace fbxsdk
{

/// A property of an object, to which other objects may be connected as sources.
class FbxProperty
{
public:
	bool IsValid() const { return true; }

	template <typename T>
	int GetSrcObjectCount() const
	{
		int count = 0;
		for (FbxObject* const pSource : m_Sources)
			count += FbxCast<T>(pSource) ? 1 : 0;
		return count;
	}

	/// Counted among the sources of that class; null if there are not so many.
	template <typename T>
	T* GetSrcObject(int pIndex = 0) const
	{
		for (FbxObject* const pSource : m_Sources)
			if (T* const pFound = FbxCast<T>(pSource); pFound && pIndex-- == 0)
				return pFound;
		return nullptr;
	}

private:
	friend class FbxFormat::VMaterialReader;

	std::vector<FbxObject*> m_Sources;
};

template <typename T>
class FbxPropertyT : public FbxProperty
{
public:
	explicit FbxPropertyT(const T& pValue) : m_Value(pValue) {}
	T Get() const { return m_Value; }

private:
	friend class FbxFormat::VMaterialReader;

	T m_Value;
};

} // namespace fbxsdk
