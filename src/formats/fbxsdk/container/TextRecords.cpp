#include "fbxsdk/container/TextScan.h"
#include "fbxsdk/container/TreeBuilder.h"

#include <charconv>
#include <cstring>

namespace
{

using namespace FbxFormat;

class VTextReader
{
public:
	VTextReader(std::string_view i_Bytes, VTreeBuilder& io_rBuilder)
	    : m_pBegin(i_Bytes.data()), m_p(m_pBegin), m_pEnd(m_pBegin + i_Bytes.size()), m_rBuilder(io_rBuilder)
	{
	}

	void Read()
	{
		m_p = Text::SkipByteOrderMark(m_p, m_pEnd);
		while (true)
		{
			m_p = Text::SkipSpace(m_p, m_pEnd);
			if (m_p == m_pEnd)
			{
				if (m_rBuilder.Depth() > 1)
					Error("it ends inside a record");
				return;
			}
			if (*m_p == '}')
			{
				if (m_rBuilder.Depth() > 1)
					m_rBuilder.Close();
				else
					Error("a brace closes no record");
				++m_p;
			}
			else if (!ReadRecord())
				return;
		}
	}

private:
	void Error(std::string_view i_What) { m_rBuilder.Error(i_What, m_p - m_pBegin); }
	bool Is(char i_Byte) const { return m_p != m_pEnd && *m_p == i_Byte; }

	/// False if reading cannot go on.
	bool ReadRecord()
	{
		const char* const pName = m_p;
		m_p = Text::ScanName(m_p, m_pEnd);
		const std::size_t length = m_p - pName;
		m_p = Text::SkipBlanks(m_p, m_pEnd);
		if (length == 0 || length > 255 || !Is(':'))
		{
			m_rBuilder.Error("the name of a record is missing", pName - m_pBegin);
			m_p = Text::SkipLine(m_p, m_pEnd);
			// A byte that begins no name must not stop the reading where it stands.
			return true;
		}
		++m_p;
		VElement element;
		element.m_Name = std::uint32_t(pName - m_pBegin);
		element.m_NameLength = std::uint8_t(length);
		m_p = FindValues();
		if (Is('*'))
			return ReadArray(element);
		const bool bLeftOut = m_rBuilder.IsLeftOut({pName, length});
		if (!ReadList(element) || (!bLeftOut && !m_rBuilder.Add(element)))
			return false;
		m_p = Text::SkipSpace(m_p, m_pEnd);
		if (!Is('{'))
		{
			if (m_p == m_pEnd && element.m_ValueCount == 0)
				Error("it ends inside a record");
			return true;
		}
		++m_p;
		return bLeftOut ? SkipBraces() : m_rBuilder.Open(m_pEnd - m_pBegin);
	}

	/// Behind a brace that opens: to behind the one that closes it. False if reading cannot go on.
	bool SkipBraces()
	{
		for (std::size_t depth = 1; depth > 0;)
		{
			m_p = Text::FindMark(m_p, m_pEnd);
			if (m_p == m_pEnd)
			{
				Error("it ends inside a record");
				return true;
			}
			const char* pAfter = m_p + 1;
			switch (*m_p)
			{
			case '{': ++depth; break;
			case '}': --depth; break;
			case ';': pAfter = Text::SkipLine(m_p, m_pEnd); break;
			default:
				pAfter = Text::ScanValue(m_p, m_pEnd);
				if (!pAfter)
				{
					Error("a quote is not closed");
					return false;
				}
			}
			m_p = pAfter;
		}
		return true;
	}

	/// Behind the colon of a name: the values, which may begin on a later line. The end of this one if there are none.
	const char* FindValues() const
	{
		const char* const pHere = Text::SkipBlanks(m_p, m_pEnd);
		const char* const pNext = Text::SkipSpace(pHere, m_pEnd);
		if (pNext == pHere || pNext == m_pEnd || *pNext == '{' || *pNext == '}')
			return pHere;
		const char* const pNameEnd = Text::ScanName(pNext, m_pEnd);
		const char* const pColon = Text::SkipBlanks(pNameEnd, m_pEnd);
		return pNameEnd != pNext && pColon != m_pEnd && *pColon == ':' ? pHere : pNext;
	}

	/// "1,2,3", over as many lines as the commas lead to.
	bool ReadList(VElement& o_rElement)
	{
		o_rElement.m_Form = EValueForm::TextList;
		if (Is(','))
			m_p = Text::SkipSpace(m_p + 1, m_pEnd);
		const char* const pValues = m_p;
		const char* pValuesEnd = m_p;
		for (const char* pNext = m_p; pNext; pNext = Text::NextValue(m_p, m_pEnd))
		{
			m_p = pNext;
			const char* const pValue = m_p;
			const char* const pValueEnd = Text::ScanValue(pValue, m_pEnd);
			if (!pValueEnd)
			{
				Error("a quote is not closed");
				return false;
			}
			if (pValueEnd == pValue)
				break;
			m_p = pValuesEnd = pValueEnd;
			++o_rElement.m_ValueCount;
		}
		o_rElement.m_Values = std::uint32_t(pValues - m_pBegin);
		o_rElement.m_ValuesSize = std::uint32_t(pValuesEnd - pValues);
		return true;
	}

	/// "*3 { a: 1,2,3 }": the numbers are not looked at, the brace that ends them is found at the speed of memory.
	bool ReadArray(VElement& o_rElement)
	{
		o_rElement.m_Form = EValueForm::TextArray;
		std::uint32_t count = 0;
		const auto [pCountEnd, error] = std::from_chars(m_p + 1, m_pEnd, count);
		m_p = Text::SkipSpace(pCountEnd, m_pEnd);
		if (error != std::errc() || !Is('{'))
		{
			Error("the count of an array is damaged");
			return m_rBuilder.Add(o_rElement);
		}
		const char* const pBody = m_p + 1;
		const char* const pBrace = static_cast<const char*>(std::memchr(pBody, '}', m_pEnd - pBody));
		if (!pBrace)
			Error("it ends inside an array");
		const char* const pBodyEnd = pBrace ? pBrace : m_pEnd;
		const char* pNumbers = Text::SkipSpace(pBody, pBodyEnd);
		if (pBodyEnd - pNumbers >= 2 && pNumbers[0] == 'a' && pNumbers[1] == ':')
			pNumbers += 2;
		// Each number needs a digit and a comma.
		else if (count > 0)
			count = 0xFFFFFFFFu;
		if (count > std::uint64_t(pBodyEnd - pNumbers + 1) / 2)
			Error("the numbers of an array are missing");
		else if (pBrace)
		{
			o_rElement.m_Values = std::uint32_t(pNumbers - m_pBegin);
			o_rElement.m_ValuesSize = std::uint32_t(pBodyEnd - pNumbers);
			o_rElement.m_ValueCount = count;
		}
		m_p = pBrace ? pBrace + 1 : m_pEnd;
		return m_rBuilder.Add(o_rElement);
	}

	const char* const m_pBegin;
	const char* m_p;
	const char* const m_pEnd;
	VTreeBuilder& m_rBuilder;
};

} // namespace

void FbxFormat::ReadTextRecords(std::string_view i_Bytes, VTreeBuilder& io_rBuilder)
{
	VTextReader(i_Bytes, io_rBuilder).Read();
}
