#include "TakeIO/FbxCurve.h"

#include "TakeIO/Limits.h"
#include "fbxsdk/container/Values.h"

#include <algorithm>
#include <bit>
#include <cmath>
#include <limits>

namespace
{

using namespace FbxFormat;

enum EFlags : std::uint32_t
{
	EConstant = 0x2,
	ELinear = 0x4,
	/// Of constant keys.
	ENext = 0x100,
	/// Of cubic keys.
	EAuto = 0x100,
	ETcb = 0x200,
	EBroken = 0x800,
	EClamp = 0x1000,
	ETimeIndependent = 0x2000,
	EProgressive = 0x4000,
	EWeightedRight = 0x01000000,
	EWeightedNextLeft = 0x02000000
};

/// Weights are stored as parts of this.
constexpr double c_WeightUnit = 9999.0;

/// Text files of later versions print the bits of these numbers as whole ones. No slope is printed as a whole number
/// that is so large, and no bits but those of 0 are so small.
float DataOf(double i_Number, bool i_bText)
{
	const double size = std::abs(i_Number);
	if (i_bText && size >= 8388608.0 && size < 4294967296.0 && i_Number == std::floor(i_Number))
		return std::bit_cast<float>(std::uint32_t(std::int64_t(i_Number)));
	return float(i_Number);
}

} // namespace

bool TakeIO::VFbxCurve::Read(const VElementTree& i_rTree, VElementIndex i_Curve, VDecodeBudget& io_rBudget)
{
	const auto read = [&](const char* i_pName, auto& o_rNumbers)
	{
		const VElementIndex element = i_rTree.Find(i_Curve, i_pName);
		return element == c_NoElement || ReadArray(i_rTree, element, io_rBudget, o_rNumbers);
	};
	VArrayNumbers<std::int64_t> times;
	VArrayNumbers<double> values, data;
	VArrayNumbers<std::int32_t> flags, counts;
	if (!read("KeyTime", times) || !read("KeyValueFloat", values) || !read("KeyAttrFlags", flags)
	    || !read("KeyAttrDataFloat", data) || !read("KeyAttrRefCount", counts) || times.empty()
	    || times.size() != values.size() || flags.size() != counts.size() || data.size() != 4 * flags.size())
		return false;
	m_Keys.clear();
	m_Keys.reserve(times.size());
	for (std::size_t i = 0; i < times.size(); ++i)
	{
		if (!(std::abs(values[i]) <= Limits::c_Largest) || (i > 0 && times[i] <= times[i - 1]))
			return false;
		VKey& rKey = m_Keys.emplace_back();
		rKey.m_Time = double(times[i]);
		rKey.m_Value = values[i];
		// Without a word about how, straight.
		rKey.m_Flags = flags.empty() ? std::uint32_t(ELinear) : 0;
	}
	const VElementIndex dataElement = i_rTree.Find(i_Curve, "KeyAttrDataFloat");
	const bool bText = dataElement != c_NoElement && i_rTree[dataElement].m_Form != EValueForm::Binary;
	std::size_t key = 0;
	for (std::size_t group = 0; group < flags.size(); ++group)
		for (std::int32_t count = counts[group]; count > 0 && key < m_Keys.size(); --count, ++key)
		{
			VKey& rKey = m_Keys[key];
			rKey.m_Flags = std::uint32_t(flags[group]);
			for (std::size_t i = 0; i < 2; ++i)
				rKey.m_Data[i] = DataOf(data[4 * group + i], bText);
			const float packed = DataOf(data[4 * group + 2], bText);
			rKey.m_Data[2] = packed;
			const auto weights = std::bit_cast<std::uint32_t>(packed);
			if (rKey.m_Flags & EWeightedRight)
				rKey.m_RightWeight = std::clamp((weights & 0xFFFF) / c_WeightUnit, 0.0, 1.0);
			if (rKey.m_Flags & EWeightedNextLeft)
				rKey.m_NextLeftWeight = std::clamp((weights >> 16) / c_WeightUnit, 0.0, 1.0);
		}
	return SetSlopes();
}

bool TakeIO::VFbxCurve::ReadKeys(const VElementTree& i_rTree, VElementIndex i_Keys, VDecodeBudget& io_rBudget)
{
	VValueCursor cursor(i_rTree, i_Keys);
	// A letter is a word of the text form, a number of the binary one.
	const auto letter = [&cursor]
	{
		const VValue value = cursor.Next();
		return value.m_Kind == EValueKind::Word && value.m_Text.size() == 1 ? value.m_Text[0] : char(value.AsInteger());
	};
	m_Keys.clear();
	for (VValue time = cursor.Next(); time.m_Kind != EValueKind::None; time = cursor.Next())
	{
		if (!io_rBudget.Take(sizeof(VKey)))
			return false;
		VKey& rKey = m_Keys.emplace_back();
		rKey.m_Time = time.AsReal(std::numeric_limits<double>::quiet_NaN());
		rKey.m_Value = cursor.Next().AsReal(std::numeric_limits<double>::quiet_NaN());
		const bool bLater = m_Keys.size() < 2 || rKey.m_Time > m_Keys[m_Keys.size() - 2].m_Time;
		if (!(std::abs(rKey.m_Value) <= Limits::c_Largest) || !std::isfinite(rKey.m_Time) || !bLater)
			return false;
		switch (letter())
		{
		case 'L': rKey.m_Flags = ELinear; continue;
		case 'C': rKey.m_Flags = letter() == 'n' ? EConstant | ENext : EConstant; continue;
		case 'U': break;
		default: return false;
		}
		std::size_t numbers = 2;
		switch (letter())
		{
		case 's': break;
		case 'b': rKey.m_Flags = EBroken; break;
		case 'a':
			rKey.m_Flags = EAuto;
			numbers = 0;
			break;
		case 't':
			rKey.m_Flags = ETcb;
			numbers = 3;
			break;
		default: return false;
		}
		for (std::size_t i = 0; i < numbers; ++i)
			rKey.m_Data[i] = cursor.Next().AsReal();
		const char weights = letter();
		if (weights != 'n' && weights != 'r' && weights != 'l' && weights != 'a')
			return false;
		const auto weight = [&](std::uint32_t i_Flag, double& o_rWeight)
		{
			rKey.m_Flags |= i_Flag;
			o_rWeight = std::clamp(cursor.Next().AsReal(1.0 / 3.0), 0.0, 1.0);
		};
		if (weights == 'r' || weights == 'a')
			weight(EWeightedRight, rKey.m_RightWeight);
		if (weights == 'l' || weights == 'a')
			weight(EWeightedNextLeft, rKey.m_NextLeftWeight);
	}
	return !m_Keys.empty() && SetSlopes();
}

double TakeIO::VFbxCurve::Secant(std::size_t i_Key) const
{
	const VKey& rKey = m_Keys[i_Key];
	const VKey& rNext = m_Keys[i_Key + 1];
	return (rNext.m_Value - rKey.m_Value) / ((rNext.m_Time - rKey.m_Time) / c_FbxSecond);
}

double TakeIO::VFbxCurve::AutoSlope(std::size_t i_Key) const
{
	const VKey& rKey = m_Keys[i_Key];
	const bool bFirst = i_Key == 0;
	const bool bLast = i_Key + 1 == m_Keys.size();
	if (bFirst || bLast)
		return rKey.m_Flags & EProgressive || m_Keys.size() == 1 ? 0.0 : Secant(bFirst ? 0 : i_Key - 1);
	const double left = Secant(i_Key - 1);
	const double right = Secant(i_Key);
	const double before = rKey.m_Time - m_Keys[i_Key - 1].m_Time;
	const double behind = m_Keys[i_Key + 1].m_Time - rKey.m_Time;
	const double whole = before + behind;
	double slope = rKey.m_Flags & ETimeIndependent ? (left * behind + right * before) / whole
	                                               : (left * before + right * behind) / whole;
	if (rKey.m_Flags & EClamp && (left == 0.0 || right == 0.0))
		return 0.0;
	if (!(rKey.m_Flags & EProgressive))
		return slope;
	// A slope that reaches a third of the way stays between two values up to three times their secant.
	if (left * right <= 0.0)
		return 0.0;
	const double most = 3.0 * std::min(std::abs(left), std::abs(right));
	return std::clamp(slope, -most, most);
}

double TakeIO::VFbxCurve::TcbSlope(std::size_t i_Key, bool i_bIn) const
{
	if (m_Keys.size() == 1)
		return 0.0;
	const auto& [tension, continuity, bias] = m_Keys[i_Key].m_Data;
	const double right = Secant(std::min(i_Key, m_Keys.size() - 2));
	const double left = i_Key > 0 ? Secant(i_Key - 1) : right;
	const double sign = i_bIn ? -1.0 : 1.0;
	return 0.5 * (1.0 - tension)
	    * ((1.0 + sign * continuity) * (1.0 + bias) * left + (1.0 - sign * continuity) * (1.0 - bias) * right);
}

bool TakeIO::VFbxCurve::SetSlopes()
{
	for (std::size_t i = 0; i < m_Keys.size(); ++i)
	{
		VKey& rKey = m_Keys[i];
		if (rKey.m_Flags & (EConstant | ELinear))
			continue;
		rKey.m_Right = rKey.m_Flags & ETcb ? TcbSlope(i, false) : rKey.m_Flags & EAuto ? AutoSlope(i) : rKey.m_Data[0];
		if (i + 1 == m_Keys.size())
			break;
		// A next key that is not broken decides about both of its sides.
		const std::uint32_t next = m_Keys[i + 1].m_Flags;
		const bool bCubic = !(next & (EConstant | ELinear | EBroken));
		rKey.m_NextLeft = bCubic && next & ETcb ? TcbSlope(i + 1, true)
		    : bCubic && next & EAuto            ? AutoSlope(i + 1)
		    : rKey.m_Flags & ETcb               ? Secant(i)
		                                        : rKey.m_Data[1];
	}
	return std::ranges::all_of(
	    m_Keys, [](const VKey& i_rKey) { return std::isfinite(i_rKey.m_Right) && std::isfinite(i_rKey.m_NextLeft); });
}

double TakeIO::VFbxCurve::At(double i_Time, std::size_t& io_rNext) const
{
	const auto isNext = [&](std::size_t i_Next)
	{
		return (i_Next == 0 || m_Keys[i_Next - 1].m_Time <= i_Time)
		    && (i_Next == m_Keys.size() || i_Time < m_Keys[i_Next].m_Time);
	};
	if (!isNext(io_rNext) && (io_rNext == m_Keys.size() || !isNext(++io_rNext)))
		io_rNext = std::size_t(std::ranges::upper_bound(m_Keys, i_Time, {}, &VKey::m_Time) - m_Keys.begin());
	const auto next = m_Keys.begin() + std::ptrdiff_t(io_rNext);
	if (next == m_Keys.begin())
		return next->m_Value;
	const VKey& rKey = next[-1];
	if (next == m_Keys.end())
		return rKey.m_Value;
	if (rKey.m_Flags & EConstant)
		return rKey.m_Flags & ENext ? next->m_Value : rKey.m_Value;
	const double way = next->m_Time - rKey.m_Time;
	const double part = (i_Time - rKey.m_Time) / way;
	if (rKey.m_Flags & ELinear)
		return rKey.m_Value + part * (next->m_Value - rKey.m_Value);
	// Bezier curves over the same parameter, of time and of value.
	const double seconds = way / c_FbxSecond;
	const auto bezier = [](double i_A, double i_B, double i_C, double i_D, double i_At)
	{
		const double rest = 1.0 - i_At;
		return rest * rest * (rest * i_A + 3.0 * i_At * i_B) + i_At * i_At * (3.0 * rest * i_C + i_At * i_D);
	};
	double at = part;
	if (rKey.m_Flags & (EWeightedRight | EWeightedNextLeft))
	{
		// Weights up to 1 keep time growing.
		double least = 0.0, greatest = 1.0;
		for (int i = 0; i < 50; ++i)
		{
			at = 0.5 * (least + greatest);
			(bezier(0.0, rKey.m_RightWeight, 1.0 - rKey.m_NextLeftWeight, 1.0, at) < part ? least : greatest) = at;
		}
	}
	return bezier(rKey.m_Value, rKey.m_Value + rKey.m_Right * rKey.m_RightWeight * seconds,
	    next->m_Value - rKey.m_NextLeft * rKey.m_NextLeftWeight * seconds, next->m_Value, at);
}
