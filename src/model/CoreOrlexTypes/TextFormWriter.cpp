#include "CoreOrlexTypes/Fields.h"
#include "CoreOrlexTypes/TextForm.h"

#include "math/NumberText.h"

#include <cmath>

namespace
{

using namespace CoreOrlexTypes;

class VTextWriter
{
public:
	VTextWriter(std::string& io_rText, ETextSpelling i_Spelling)
	    : m_rText(io_rText), m_bKeyed(i_Spelling == ETextSpelling::EKeyed)
	{
	}

	bool Write(bool i_bValue)
	{
		m_rText += i_bValue ? "true" : "false";
		return true;
	}

	bool Write(std::uint32_t i_Value)
	{
		m_rText += std::to_string(i_Value);
		return true;
	}

	bool Write(std::uint8_t i_Value) { return Write(std::uint32_t(i_Value)); }

	bool Write(double i_Value)
	{
		// The spelling that expressions use for these is not one that the scan formats read.
		if (std::isfinite(i_Value))
			NumberText::AppendG17(m_rText, i_Value);
		else
			(m_rText += std::signbit(i_Value) ? "-" : "") += std::isnan(i_Value) ? "nan" : "inf";
		return true;
	}

	bool Write(std::string_view i_Value)
	{
		m_rText += '"';
		for (const char byte : i_Value)
			switch (byte)
			{
			case '\0': return false;
			case '\n': m_rText += "\\n"; break;
			case '\r': m_rText += "\\r"; break;
			case '"':
			case '\\': m_rText += '\\'; [[fallthrough]];
			// A tab too stands for itself: the escape \t would read back as two bytes.
			default: m_rText += byte;
			}
		m_rText += '"';
		return true;
	}

	bool Write(const std::string& i_rValue) { return Write(std::string_view(i_rValue)); }

	template <CEnumeration E>
	bool Write(E i_Value)
	{
		const std::string_view name = EnumeratorName(i_Value);
		return !name.empty() && Write(name);
	}

	template <typename T, std::size_t c_Count>
	bool Write(const std::array<T, c_Count>& i_rValue)
	{
		return WriteList(i_rValue);
	}

	template <typename T>
	bool Write(const std::vector<T>& i_rValue)
	{
		return WriteList(i_rValue);
	}

	template <CRecord T>
	bool Write(const T& i_rValue)
	{
		return WriteRecord(i_rValue, m_bKeyed);
	}

	bool Write(const VColour& i_rValue) { return WriteRecord(i_rValue, false); }

private:
	void NewLine() { m_rText.append(1, '\n').append(m_Depth, '\t'); }

	template <typename TList>
	bool WriteList(const TList& i_rValue)
	{
		constexpr bool c_bRecords = CRecord<typename TList::value_type>;
		m_rText += '[';
		++m_Depth;
		bool bFirst = true;
		for (const auto& rElement : i_rValue)
		{
			if (!bFirst)
				m_rText += ',';
			if (c_bRecords)
				NewLine();
			else if (!bFirst)
				m_rText += ' ';
			bFirst = false;
			if (!Write(rElement))
				return false;
		}
		--m_Depth;
		if (c_bRecords && !bFirst)
			NewLine();
		m_rText += ']';
		return true;
	}

	template <CRecord T>
	bool WriteRecord(const T& i_rValue, bool i_bKeyed)
	{
		m_rText += i_bKeyed ? '{' : '[';
		++m_Depth;
		bool bFirst = true;
		bool bGood = true;
		ForEachField<T>(
		    [&](const auto& i_rField)
		    {
			    if (!bFirst)
				    m_rText += ',';
			    if (i_bKeyed)
			    {
				    NewLine();
				    bGood = bGood && Write(i_rField.Key);
				    m_rText += ": ";
			    }
			    else if (!bFirst)
				    m_rText += ' ';
			    bFirst = false;
			    bGood = bGood && Write(i_rValue.*i_rField.pMember);
		    });
		--m_Depth;
		if (i_bKeyed)
			NewLine();
		m_rText += i_bKeyed ? '}' : ']';
		return bGood;
	}

	std::string& m_rText;
	std::size_t m_Depth = 0;
	bool m_bKeyed;
};

} // namespace

bool CoreOrlexTypes::WriteText(const VTextHeader& i_rValue, std::string& io_rText, ETextSpelling i_Spelling)
{
	return VTextWriter(io_rText, i_Spelling).Write(i_rValue);
}

bool CoreOrlexTypes::WriteText(const VSubjectRecord& i_rValue, std::string& io_rText, ETextSpelling i_Spelling)
{
	return VTextWriter(io_rText, i_Spelling).Write(i_rValue);
}

bool CoreOrlexTypes::WriteText(const VSubjectParametrised& i_rValue, std::string& io_rText, ETextSpelling i_Spelling)
{
	return VTextWriter(io_rText, i_Spelling).Write(i_rValue);
}

bool CoreOrlexTypes::WriteText(const VSubjectApplicationData& i_rValue, std::string& io_rText, ETextSpelling i_Spelling)
{
	return VTextWriter(io_rText, i_Spelling).Write(i_rValue);
}

bool CoreOrlexTypes::WriteText(const VSubject& i_rValue, std::string& io_rText, ETextSpelling i_Spelling)
{
	return VTextWriter(io_rText, i_Spelling).Write(i_rValue);
}
