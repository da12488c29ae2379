#pragma once

#include "fbxsdk/container/Arrays.h"

#include <vector>

namespace TakeIO
{

/// The ticks of a second in FBX files.
inline constexpr double c_FbxSecond = 46186158000.0;

/// A curve over time: what its file says of each key, and of the way to the next one.
/// - constant: the value of the key, or of the next one where its flags say so
/// - linear
/// - cubic, with a slope at both ends. Slopes of the user are those of the file. Automatic ones are the way from the
/// key
///   before to the one behind, over their time; "time independent": that of the parabola through the three; clamped:
///   0 beside a key of the same value; progressively clamped: no value beyond those of the neighbours, and 0 at the
///   first and last key. Tension, continuity and bias are those of Kochanek and Bartels (SIGGRAPH 1984).
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
	double FirstTime() const { return m_Keys.front().m_Time; }
	double LastTime() const { return m_Keys.back().m_Time; }

private:
	struct VKey
	{
		double m_Time;
		double m_Value;
		std::uint32_t m_Flags = 0;
		/// As they stand in the file: slopes here and at the next key, or tension, continuity and bias.
		double m_Data[3]{};
		/// By second.
		double m_Right = 0.0;
		double m_NextLeft = 0.0;
		/// How far the slopes reach, as parts of the way.
		double m_RightWeight = 1.0 / 3.0;
		double m_NextLeftWeight = 1.0 / 3.0;
	};

	double Secant(std::size_t i_Key) const;
	double AutoSlope(std::size_t i_Key) const;
	double TcbSlope(std::size_t i_Key, bool i_bIn) const;
	bool SetSlopes();

	std::vector<VKey> m_Keys;
};

} // namespace TakeIO
