#pragma once

#include <cmath>

namespace Rotation
{

/// Two doubles in one register, by the vector extension that g++ and clang share.
using VPair = double __attribute__((vector_size(16)));

/// One number of two frames, with which both are calculated at once, each in its own lane and to the same bits as
/// alone.
struct VLanes
{
	VLanes() = default;
	VLanes(double i_Both) : m_Pair{i_Both, i_Both} {}
	VLanes(double i_First, double i_Second) : m_Pair{i_First, i_Second} {}
	explicit VLanes(VPair i_Pair) : m_Pair(i_Pair) {}

	double operator[](int i_Lane) const { return m_Pair[i_Lane]; }

	friend VLanes operator+(VLanes a, VLanes b) { return VLanes(a.m_Pair + b.m_Pair); }
	friend VLanes operator-(VLanes a, VLanes b) { return VLanes(a.m_Pair - b.m_Pair); }
	friend VLanes operator*(VLanes a, VLanes b) { return VLanes(a.m_Pair * b.m_Pair); }
	friend VLanes operator-(VLanes a) { return VLanes(-a.m_Pair); }
	friend VLanes sin(VLanes a) { return {std::sin(a[0]), std::sin(a[1])}; }
	friend VLanes cos(VLanes a) { return {std::cos(a[0]), std::cos(a[1])}; }

	VPair m_Pair{};
};

} // namespace Rotation
