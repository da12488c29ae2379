#include "TakeIO/FbxCurve.h"

#include "TakeIO/Limits.h"
#include "fbxsdk/container/Values.h"

#include <algorithm>
#include <bit>
#include <cmath>
#include <limits>

/// As it stands in its file.
struct TakeIO::VFbxKey
{
	double m_Time = 0.0;
	double m_Value = 0.0;
	std::uint32_t m_Flags = 0;
	/// Slopes here and at the next key, or tension, continuity and bias.
	double m_Data[3]{};
	VFbxWeights m_Weights{};
};

namespace
{

using namespace FbxFormat;
using namespace TakeIO;

/// Slopes are by second, and asked for of two keys or more.
using VKeys = std::span<const VFbxKey>;

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

double Secant(VKeys i_Keys, std::size_t i_Key)
{
	const VFbxKey& rKey = i_Keys[i_Key];
	const VFbxKey& rNext = i_Keys[i_Key + 1];
	return (rNext.m_Value - rKey.m_Value) / ((rNext.m_Time - rKey.m_Time) / c_FbxSecond);
}

double AutoSlope(VKeys i_Keys, std::size_t i_Key)
{
	const VFbxKey& rKey = i_Keys[i_Key];
	const bool bFirst = i_Key == 0;
	const bool bLast = i_Key + 1 == i_Keys.size();
	if (bFirst || bLast)
		return rKey.m_Flags & EProgressive ? 0.0 : Secant(i_Keys, bFirst ? 0 : i_Key - 1);
	const double left = Secant(i_Keys, i_Key - 1);
	const double right = Secant(i_Keys, i_Key);
	const double before = rKey.m_Time - i_Keys[i_Key - 1].m_Time;
	const double behind = i_Keys[i_Key + 1].m_Time - rKey.m_Time;
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

double TcbSlope(VKeys i_Keys, std::size_t i_Key, bool i_bIn)
{
	const auto& [tension, continuity, bias] = i_Keys[i_Key].m_Data;
	const double right = Secant(i_Keys, std::min(i_Key, i_Keys.size() - 2));
	const double left = i_Key > 0 ? Secant(i_Keys, i_Key - 1) : right;
	const double sign = i_bIn ? -1.0 : 1.0;
	return 0.5 * (1.0 - tension)
	    * ((1.0 + sign * continuity) * (1.0 + bias) * left + (1.0 - sign * continuity) * (1.0 - bias) * right);
}

/// Only cubic ways are bent.
bool BendsTime(const VFbxKey& i_rKey)
{
	return !(i_rKey.m_Flags & (EConstant | ELinear)) && i_rKey.m_Weights != VFbxWeights();
}

/// Of the value from a key to the next one, a Bezier curve where it is cubic.
std::array<double, 4> FactorsBehind(VKeys i_Keys, std::size_t i_Key)
{
	const VFbxKey& rKey = i_Keys[i_Key];
	if (i_Key + 1 == i_Keys.size())
		return {rKey.m_Value};
	const VFbxKey& rNext = i_Keys[i_Key + 1];
	if (rKey.m_Flags & EConstant)
		return {rKey.m_Flags & ENext ? rNext.m_Value : rKey.m_Value};
	if (rKey.m_Flags & ELinear)
		return {rKey.m_Value, rNext.m_Value - rKey.m_Value};
	const double slope = rKey.m_Flags & ETcb ? TcbSlope(i_Keys, i_Key, false)
	    : rKey.m_Flags & EAuto               ? AutoSlope(i_Keys, i_Key)
	                                         : rKey.m_Data[0];
	// A next key that is not broken decides about both of its sides.
	const bool bCubic = !(rNext.m_Flags & (EConstant | ELinear | EBroken));
	const double nextSlope = bCubic && rNext.m_Flags & ETcb ? TcbSlope(i_Keys, i_Key + 1, true)
	    : bCubic && rNext.m_Flags & EAuto                   ? AutoSlope(i_Keys, i_Key + 1)
	    : rKey.m_Flags & ETcb                               ? Secant(i_Keys, i_Key)
	                                                        : rKey.m_Data[1];
	const double seconds = (rNext.m_Time - rKey.m_Time) / c_FbxSecond;
	// From each end to the point of the curve beside it, and from end to end.
	const double first = slope * rKey.m_Weights.m_Right * seconds;
	const double last = nextSlope * rKey.m_Weights.m_NextLeft * seconds;
	const double whole = rNext.m_Value - rKey.m_Value;
	return {rKey.m_Value, 3.0 * first, 3.0 * (whole - last - 2.0 * first), 3.0 * (first + last) - 2.0 * whole};
}

/// The parameter at which time, a Bezier curve too, has gone so far.
double Unbent(const VFbxWeights& i_rWeights, double i_Part)
{
	if (i_rWeights == VFbxWeights())
		return i_Part;
	// Weights up to 1 keep time growing.
	double least = 0.0, greatest = 1.0, at = i_Part;
	for (int i = 0; i < 50; ++i)
	{
		at = 0.5 * (least + greatest);
		const double rest = 1.0 - at;
		const double time =
		    3.0 * at * rest * (rest * i_rWeights.m_Right + at * (1.0 - i_rWeights.m_NextLeft)) + at * at * at;
		(time < i_Part ? least : greatest) = at;
	}
	return at;
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
	const VElementIndex dataElement = i_rTree.Find(i_Curve, "KeyAttrDataFloat");
	const bool bText = dataElement != c_NoElement && i_rTree[dataElement].m_Form != EValueForm::Binary;
	std::vector<VFbxKey> keys;
	keys.reserve(times.size());
	for (std::size_t group = 0; group < flags.size(); ++group)
	{
		VFbxKey key{.m_Flags = std::uint32_t(flags[group])};
		for (std::size_t i = 0; i < 2; ++i)
			key.m_Data[i] = DataOf(data[4 * group + i], bText);
		const float packed = DataOf(data[4 * group + 2], bText);
		key.m_Data[2] = packed;
		const auto weights = std::bit_cast<std::uint32_t>(packed);
		if (key.m_Flags & EWeightedRight)
			key.m_Weights.m_Right = std::clamp((weights & 0xFFFF) / c_WeightUnit, 0.0, 1.0);
		if (key.m_Flags & EWeightedNextLeft)
			key.m_Weights.m_NextLeft = std::clamp((weights >> 16) / c_WeightUnit, 0.0, 1.0);
		keys.insert(keys.end(), std::min(std::size_t(std::max(counts[group], 0)), times.size() - keys.size()), key);
	}
	// Without a word about how, straight.
	keys.resize(times.size(), {.m_Flags = flags.empty() ? std::uint32_t(ELinear) : 0});
	for (std::size_t i = 0; i < keys.size(); ++i)
	{
		if (!(std::abs(values[i]) <= Limits::c_Largest) || (i > 0 && times[i] <= times[i - 1]))
			return false;
		keys[i].m_Time = double(times[i]);
		keys[i].m_Value = values[i];
	}
	return SetSpans(keys);
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
	std::vector<VFbxKey> keys;
	for (VValue time = cursor.Next(); time.m_Kind != EValueKind::None; time = cursor.Next())
	{
		if (!io_rBudget.Take(sizeof(VFbxKey)))
			return false;
		VFbxKey& rKey = keys.emplace_back();
		rKey.m_Time = time.AsReal(std::numeric_limits<double>::quiet_NaN());
		rKey.m_Value = cursor.Next().AsReal(std::numeric_limits<double>::quiet_NaN());
		const bool bLater = keys.size() < 2 || rKey.m_Time > keys[keys.size() - 2].m_Time;
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
		const auto weight = [&] { return std::clamp(cursor.Next().AsReal(1.0 / 3.0), 0.0, 1.0); };
		if (weights == 'r' || weights == 'a')
			rKey.m_Weights.m_Right = weight();
		if (weights == 'l' || weights == 'a')
			rKey.m_Weights.m_NextLeft = weight();
	}
	return !keys.empty() && SetSpans(keys);
}

bool TakeIO::VFbxCurve::SetSpans(VKeys i_Keys)
{
	m_Spans.clear();
	m_Spans.reserve(i_Keys.size());
	for (std::size_t i = 0; i < i_Keys.size(); ++i)
	{
		m_Spans.push_back({i_Keys[i].m_Time, FactorsBehind(i_Keys, i)});
		if (!std::ranges::all_of(m_Spans.back().m_Factors, [](double i_Factor) { return std::isfinite(i_Factor); }))
			return false;
	}
	m_Weights.clear();
	if (std::ranges::any_of(i_Keys, BendsTime))
		for (const VFbxKey& rKey : i_Keys)
			m_Weights.push_back(BendsTime(rKey) ? rKey.m_Weights : VFbxWeights());
	return true;
}

double TakeIO::VFbxCurve::At(double i_Time, std::size_t& io_rNext) const
{
	const auto isNext = [&](std::size_t i_Next)
	{
		return (i_Next == 0 || m_Spans[i_Next - 1].m_Time <= i_Time)
		    && (i_Next == m_Spans.size() || i_Time < m_Spans[i_Next].m_Time);
	};
	if (!isNext(io_rNext) && (io_rNext == m_Spans.size() || !isNext(++io_rNext)))
		io_rNext = std::size_t(std::ranges::upper_bound(m_Spans, i_Time, {}, &VSpan::m_Time) - m_Spans.begin());
	// Curves are asked in turns, hundreds in a frame: no processor sees by itself that each of them goes on.
	__builtin_prefetch(&m_Spans[std::min(io_rNext + 2, m_Spans.size() - 1)]);
	const VSpan& rSpan = m_Spans[std::max<std::size_t>(io_rNext, 1) - 1];
	const auto& [a, b, c, d] = rSpan.m_Factors;
	if (io_rNext == 0 || io_rNext == m_Spans.size())
		return a;
	double part = (i_Time - rSpan.m_Time) / (m_Spans[io_rNext].m_Time - rSpan.m_Time);
	if (!m_Weights.empty())
		part = Unbent(m_Weights[io_rNext - 1], part);
	return a + part * (b + part * (c + part * d));
}
