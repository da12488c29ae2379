#include "CoreOrlexTypes/Fields.h"
#include "CoreOrlexTypes/Limits.h"
#include "CoreOrlexTypes/TextForm.h"

#include "math/NumberText.h"

#include <algorithm>

namespace
{

using namespace CoreOrlexTypes;

/// A position in the text. The Read functions skip white space first, return false at the first thing that does not
/// fit, and recurse only as deep as the types nest.
class VTextReader
{
public:
	explicit VTextReader(std::string_view i_Text)
	    : m_pBegin(i_Text.data()), m_pAt(i_Text.data()), m_pEnd(std::find(m_pAt, m_pAt + i_Text.size(), '\0'))
	{
	}

	std::size_t NumberOfBytesRead() const { return m_pAt - m_pBegin; }

	bool Read(bool& o_rValue)
	{
		SkipSpace();
		for (const auto& [rToken, bValue] :
		    {std::pair<std::string_view, bool>("0", false), {"1", true}, {"false", false}, {"true", true}})
		{
			if (!std::string_view(m_pAt, m_pEnd).starts_with(rToken))
				continue;
			m_pAt += rToken.size();
			o_rValue = bValue;
			return true;
		}
		return false;
	}

	/// As strtoul with base 10 where a long has 32 bits: white space, a sign, saturation; a minus wraps around.
	bool Read(std::uint32_t& o_rValue)
	{
		while (m_pAt != m_pEnd && (*m_pAt == ' ' || (*m_pAt >= '\t' && *m_pAt <= '\r')))
			++m_pAt;
		const bool bNegative = m_pAt != m_pEnd && *m_pAt == '-';
		if (m_pAt != m_pEnd && (*m_pAt == '-' || *m_pAt == '+'))
			++m_pAt;
		const char* const pDigits = m_pAt;
		std::uint64_t value = 0;
		for (; m_pAt != m_pEnd && *m_pAt >= '0' && *m_pAt <= '9'; ++m_pAt)
			value = std::min<std::uint64_t>(value * 10 + (*m_pAt - '0'), std::uint64_t(1) << 32);
		if (m_pAt == pDigits)
			return false;
		if (value > 0xFFFFFFFFu)
			o_rValue = 0xFFFFFFFFu;
		else
			o_rValue = bNegative ? 0u - std::uint32_t(value) : std::uint32_t(value);
		return true;
	}

	bool Read(std::uint8_t& o_rValue)
	{
		std::uint32_t value = 0;
		if (!Read(value) || value >= 256)
			return false;
		o_rValue = std::uint8_t(value);
		return true;
	}

	bool Read(double& o_rValue)
	{
		const std::size_t read = NumberText::ScanReal(std::string_view(m_pAt, m_pEnd), o_rValue);
		m_pAt += read;
		return read != 0;
	}

	bool Read(std::string& o_rValue)
	{
		if (!Take('"'))
			return false;
		o_rValue.clear();
		for (; m_pAt != m_pEnd && *m_pAt != '"'; ++m_pAt)
		{
			if (*m_pAt != '\\')
			{
				o_rValue += *m_pAt;
				continue;
			}
			if (++m_pAt == m_pEnd)
				return false;
			switch (*m_pAt)
			{
			case 'n': o_rValue += '\n'; break;
			case 'r': o_rValue += '\r'; break;
			// Existing files are read by programs that do the same: the letter stays.
			case 't': o_rValue += "\tt"; break;
			default: o_rValue += *m_pAt;
			}
		}
		if (m_pAt == m_pEnd)
			return false;
		++m_pAt;
		return true;
	}

	template <CEnumeration E>
	bool Read(E& o_rValue)
	{
		std::string name;
		if (!Read(name))
			return false;
		const std::optional<E> value = EnumeratorFromName<E>(name);
		if (!value)
			return false;
		o_rValue = *value;
		return true;
	}

	template <typename T, std::size_t c_Count>
	bool Read(std::array<T, c_Count>& o_rValue)
	{
		std::size_t count = 0;
		return ReadList([&] { return count < c_Count && Read(o_rValue[count++]); }) && count == c_Count;
	}

	template <typename T>
	bool Read(std::vector<T>& o_rValue)
	{
		o_rValue.clear();
		return ReadList(
		    [&]
		    {
			    if (m_ElementBytesLeft < sizeof(T))
				    return false;
			    m_ElementBytesLeft -= sizeof(T);
			    return Read(o_rValue.emplace_back());
		    });
	}

	template <CRecord T>
	bool Read(T& io_rValue)
	{
		SkipSpace();
		return m_pAt != m_pEnd && *m_pAt == '{' ? ReadKeyed(io_rValue) : ReadPositional(io_rValue);
	}

	bool Read(VColour& io_rValue) { return ReadPositional(io_rValue); }

	/// A marker is nothing but its colour, and files spell it with or without a list of its own around the colour.
	bool Read(VSubjectApplicationData::VMarker& io_rValue)
	{
		SkipSpace();
		const char* const pBegin = m_pAt;
		if (m_pAt != m_pEnd && *m_pAt == '{')
			return ReadKeyed(io_rValue);
		if (!Take('['))
			return false;
		SkipSpace();
		const bool bNested = m_pAt != m_pEnd && *m_pAt == '[';
		m_pAt = pBegin;
		return bNested ? ReadPositional(io_rValue) : Read(io_rValue.m_Colour);
	}

private:
	void SkipSpace()
	{
		while (m_pAt != m_pEnd && (*m_pAt == ' ' || *m_pAt == '\t' || *m_pAt == '\n' || *m_pAt == '\r'))
			++m_pAt;
	}

	bool Take(char i_Byte)
	{
		SkipSpace();
		if (m_pAt == m_pEnd || *m_pAt != i_Byte)
			return false;
		++m_pAt;
		return true;
	}

	template <typename TReadElement>
	bool ReadList(TReadElement i_ReadElement)
	{
		if (!Take('['))
			return false;
		if (Take(']'))
			return true;
		do
			if (!i_ReadElement())
				return false;
		while (Take(','));
		return Take(']');
	}

	template <CRecord T>
	bool ReadPositional(T& io_rValue)
	{
		bool bFirst = true;
		bool bGood = Take('[');
		ForEachField<T>(
		    [&](const auto& i_rField)
		    {
			    bGood = bGood && (bFirst || Take(',')) && Read(io_rValue.*i_rField.pMember);
			    bFirst = false;
		    });
		return bGood && Take(']');
	}

	/// Walks over the record first and notes where the value of each field stands, then reads the fields in their
	/// declared order.
	template <CRecord T>
	bool ReadKeyed(T& io_rValue)
	{
		std::array<const char*, c_FieldCount<T>> begins{};
		std::array<const char*, c_FieldCount<T>> ends{};
		if (!Take('{'))
			return false;
		if (!Take('}'))
		{
			std::string key;
			do
			{
				if (!Read(key) || !Take(':'))
					return false;
				const char* const pValue = m_pAt;
				SkipValue();
				std::size_t index = 0;
				ForEachField<T>(
				    [&](const auto& i_rField)
				    {
					    if (i_rField.Key == key && !begins[index])
					    {
						    begins[index] = pValue;
						    ends[index] = m_pAt;
					    }
					    ++index;
				    });
			} while (Take(','));
			if (!Take('}'))
				return false;
		}

		const char* const pBehind = m_pAt;
		bool bGood = true;
		std::size_t index = 0;
		ForEachField<T>(
		    [&](const auto& i_rField)
		    {
			    if (bGood && begins[index])
			    {
				    m_pAt = begins[index];
				    bGood = Read(io_rValue.*i_rField.pMember);
				    SkipSpace();
				    bGood = bGood && m_pAt == ends[index];
			    }
			    ++index;
		    });
		m_pAt = pBehind;
		return bGood;
	}

	/// Goes to the "," or closing bracket that ends the value, or to the end of the text.
	void SkipValue()
	{
		std::size_t depth = 0;
		for (; m_pAt != m_pEnd; ++m_pAt)
			switch (*m_pAt)
			{
			case '"':
				for (++m_pAt; m_pAt != m_pEnd && *m_pAt != '"'; ++m_pAt)
					if (*m_pAt == '\\' && ++m_pAt == m_pEnd)
						return;
				if (m_pAt == m_pEnd)
					return;
				break;
			case '[':
			case '{': ++depth; break;
			case ']':
			case '}':
				if (depth == 0)
					return;
				--depth;
				break;
			case ',':
				if (depth == 0)
					return;
				break;
			default: break;
			}
	}

	const char* m_pBegin;
	const char* m_pAt;
	const char* m_pEnd;
	std::size_t m_ElementBytesLeft = c_MaxTextElementBytes;
};

template <typename T>
bool ReadTopLevel(std::string_view i_Text, T& io_rValue, std::size_t* o_pRead)
{
	VTextReader reader(i_Text);
	const bool bGood = reader.Read(io_rValue);
	if (o_pRead)
		*o_pRead = reader.NumberOfBytesRead();
	return bGood;
}

} // namespace

bool CoreOrlexTypes::ReadText(std::string_view i_Text, VTextHeader& io_rValue, std::size_t* o_pRead)
{
	return ReadTopLevel(i_Text, io_rValue, o_pRead);
}

bool CoreOrlexTypes::ReadText(std::string_view i_Text, VSubjectRecord& io_rValue, std::size_t* o_pRead)
{
	return ReadTopLevel(i_Text, io_rValue, o_pRead);
}

bool CoreOrlexTypes::ReadText(std::string_view i_Text, VSubjectParametrised& io_rValue, std::size_t* o_pRead)
{
	return ReadTopLevel(i_Text, io_rValue, o_pRead);
}

bool CoreOrlexTypes::ReadText(std::string_view i_Text, VSubjectApplicationData& io_rValue, std::size_t* o_pRead)
{
	return ReadTopLevel(i_Text, io_rValue, o_pRead);
}

bool CoreOrlexTypes::ReadText(std::string_view i_Text, VSubject& io_rValue, std::size_t* o_pRead)
{
	return ReadTopLevel(i_Text, io_rValue, o_pRead);
}
