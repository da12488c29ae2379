#pragma once

#include "fbxsdk/container/Arrays.h"

#include <array>
#include <span>
#include <vector>

namespace TakeIO
{

/// The ticks of a second in FBX files.
inline constexpr double c_FbxSecond = 46186158000.0;

struct VFbxKey;

/// How far the slopes of a way between keys reach, as parts of it, at its key and before the next one.
struct VFbxWeights
{
	double m_Right = 1.0 / 3.0;
	double m_NextLeft = 1.0 / 3.0;

	bool operator==(const VFbxWeights&) const = default;
};

/// A curve over time: what its file says of each key, and of the way to the next one.
/// - constant: the value of the key, or of the next one where its flags say so
/// - linear
/// - cubic, with a slope at both ends. Slopes of the user are those of the file. Automatic ones are the way from the
///   key before to the one behind, over their time; "time independent": that of the parabola through the three;
///   clamped: 0 beside a key of the same value; progressively clamped: no value beyond those of the neighbours, and
///   0 at the first and last key. Tension, continuity and bias are those of Kochanek and Bartels (SIGGRAPH 1984).
/// Before the first and behind the last key it stands still.
class VFbxCurve
{
public:
	/// @return false if the record is no curve, is damaged, or beyond the budget.
	bool Read(
	    const FbxFormat::VElementTree& i_rTree, FbxFormat::VElementIndex i_Curve, FbxFormat::VDecodeBudget& io_rBudget);

	/// The same of a record "Key" of versions before 7: of each key time, value and letters that tell the rest.
	bool ReadKeys(
	    const FbxFormat::VElementTree& i_rTree, FbxFormat::VElementIndex i_Keys, FbxFormat::VDecodeBudget& io_rBudget);

	/// Time in ticks.
	/// @param io_rNext the key behind the time, 0 before the first call and that of the last one then: times that grow
	/// from call to call need no search.
	double At(double i_Time, std::size_t& io_rNext) const;
	double FirstTime() const { return m_Spans.front().m_Time; }
	double LastTime() const { return m_Spans.back().m_Time; }

private:
	/// The way from a key to the next one. The last one goes nowhere.
	struct VSpan
	{
		/// Of its key, in ticks.
		double m_Time;
		/// Of the powers of a parameter from 0 to 1: the part of the time, unless weights bend that.
		std::array<double, 4> m_Factors;
	};

	bool SetSpans(std::span<const VFbxKey> i_Keys);

	std::vector<VSpan> m_Spans;
	/// Of each span; none where all slopes reach a third of the way, which bends no time.
	std::vector<VFbxWeights> m_Weights;
};

} // namespace TakeIO
