#include "fbxsdk/container/Values.h"

#include "fbxsdk/container/BinaryValues.h"
#include "fbxsdk/container/TextScan.h"
#include "math/NumberText.h"

#include <charconv>
#include <cmath>
#include <limits>

namespace
{

using namespace FbxFormat;

VValue Integer(std::int64_t i_Value)
{
	VValue value;
	value.m_Kind = EValueKind::Integer;
	value.m_Integer = i_Value;
	return value;
}

VValue Real(double i_Value)
{
	VValue value;
	value.m_Kind = EValueKind::Real;
	value.m_Real = i_Value;
	return value;
}

VValue TextValue(EValueKind i_Kind, std::string_view i_Text)
{
	VValue value;
	value.m_Kind = i_Kind;
	value.m_Text = i_Text;
	return value;
}

/// The value was found sound when the record was read.
VValue LoadBinary(const char* i_pFrom)
{
	const char* const p = i_pFrom + 1;
	switch (*i_pFrom)
	{
	case 'B':
	case 'C':
	case 'Z': return Integer(Binary::Load<std::int8_t>(p));
	case 'Y': return Integer(Binary::Load<std::int16_t>(p));
	case 'I': return Integer(Binary::Load<std::int32_t>(p));
	case 'L': return Integer(Binary::Load<std::int64_t>(p));
	case 'F': return Real(Binary::Load<float>(p));
	case 'D': return Real(Binary::Load<double>(p));
	case 'S':
	case 'R': return TextValue(EValueKind::Text, {p + 4, Binary::Load<std::uint32_t>(p)});
	default: return TextValue(EValueKind::Array, {});
	}
}

VValue LoadText(std::string_view i_Text)
{
	if (i_Text.front() == '"')
		return TextValue(EValueKind::Text, i_Text.substr(1, i_Text.size() - 2));
	return ParseNumber(i_Text);
}

} // namespace

double FbxFormat::VValue::AsReal(double i_Default) const
{
	return m_Kind == EValueKind::Real ? m_Real : m_Kind == EValueKind::Integer ? double(m_Integer) : i_Default;
}

std::int64_t FbxFormat::VValue::AsInteger(std::int64_t i_Default) const
{
	if (m_Kind == EValueKind::Integer)
		return m_Integer;
	// Beyond this a double is no whole number of 64 bits.
	return m_Kind == EValueKind::Real && std::abs(m_Real) < 9e18 ? std::int64_t(m_Real) : i_Default;
}

FbxFormat::VValue FbxFormat::ParseNumber(std::string_view i_Text)
{
	std::int64_t integer = 0;
	const char* const pEnd = i_Text.data() + i_Text.size();
	if (const auto [p, error] = std::from_chars(i_Text.data(), pEnd, integer); error == std::errc() && p == pEnd)
		return Integer(integer);
	double real = 0.0;
	const std::size_t size = NumberText::ScanReal(i_Text, real);
	if (size == i_Text.size() && size > 0)
		return Real(real);
	// What C libraries print for numbers that are not finite: "nan(ind)", and "1.#INF" on Windows of old.
	if (size > 0 && std::isnan(real) && i_Text[size] == '(' && i_Text.back() == ')')
		return Real(real);
	if (size > 0 && i_Text[size] == '#')
		return Real(i_Text.substr(size).starts_with("#INF") ? real * std::numeric_limits<double>::infinity()
		                                                    : std::numeric_limits<double>::quiet_NaN());
	return TextValue(EValueKind::Word, i_Text);
}

FbxFormat::VValueCursor::VValueCursor(const VElementTree& i_rTree, VElementIndex i_Element)
    : m_p(i_rTree.Values(i_Element).data()), m_pEnd(m_p + i_rTree.Values(i_Element).size()),
      m_Form(i_rTree[i_Element].m_Form)
{
}

FbxFormat::VValue FbxFormat::VValueCursor::Next()
{
	if (m_p == m_pEnd)
		return {};
	if (m_Form == EValueForm::TextArray)
	{
		m_p = m_pEnd;
		return TextValue(EValueKind::Array, {});
	}
	const char* const pValue = m_p;
	if (m_Form == EValueForm::Binary)
	{
		m_p = Binary::SkipValue(m_p, m_pEnd);
		return LoadBinary(pValue);
	}
	m_p = Text::ScanValue(pValue, m_pEnd);
	const std::string_view text(pValue, m_p - pValue);
	const char* const pNext = Text::NextValue(m_p, m_pEnd);
	m_p = pNext ? pNext : m_pEnd;
	return LoadText(text);
}

void FbxFormat::VValueCursor::Skip(int i_Count)
{
	for (; i_Count > 0 && m_p != m_pEnd; --i_Count)
	{
		if (m_Form == EValueForm::Binary)
			m_p = Binary::SkipValue(m_p, m_pEnd);
		else
			(void)Next();
	}
}

FbxFormat::VValue FbxFormat::ValueAt(const VElementTree& i_rTree, VElementIndex i_Element, int i_Place)
{
	VValueCursor cursor(i_rTree, i_Element);
	cursor.Skip(i_Place);
	return cursor.Next();
}
