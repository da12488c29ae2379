#pragma once

#include <cstdint>
#include <limits>

namespace fbxsdk
{

using FbxLongLong = std::int64_t;

class FbxTime
{
public:
	explicit FbxTime(FbxLongLong pTime = 0) : m_Time(pTime) {}
	FbxLongLong Get() const { return m_Time; }

private:
	FbxLongLong m_Time;
};

} // namespace fbxsdk

/// Stands for the pose that the nodes have without any animation.
#define FBXSDK_TIME_INFINITE fbxsdk::FbxTime(std::numeric_limits<fbxsdk::FbxLongLong>::max())
