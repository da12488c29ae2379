#include "TesselDataStore/ValueText.h"

#include "TesselDataStore/BinaryReader.h"

#include "math/NumberText.h"

#include <utility>

namespace TesselDataStore
{

namespace
{

using NVX::IO::EType;
using NVX::IO::ISchema;
using NVX::IO::VSchemaChild;

/// Walks a schema and its bytes. Each function returns false when there is nothing more to say.
class VPrinter
{
public:
	VPrinter(std::string_view i_Bytes, std::size_t i_MostBytes) : m_Bytes(i_Bytes), m_MostBytes(i_MostBytes) {}

	std::string Print(const ISchema& i_rSchema)
	{
		try
		{
			if (Value(i_rSchema) && m_Bytes.BytesLeft() != 0)
				m_Text += " (" + std::to_string(m_Bytes.BytesLeft()) + " bytes more)";
		}
		catch (const std::runtime_error& rError)
		{
			(m_Text += " (") += std::string(rError.what()) + ")";
		}
		return std::move(m_Text);
	}

private:
	bool Value(const ISchema& i_rSchema)
	{
		if (m_Text.size() > m_MostBytes)
		{
			m_Text += "...";
			return false;
		}
		switch (i_rSchema.m_Type)
		{
		case EType::EVoid: m_Text += "void"; return true;
		case EType::EBool: m_Text += m_Bytes.Number<std::uint8_t>() ? "true" : "false"; return true;
		case EType::EInt8: return Integer<std::int8_t>();
		case EType::EInt16: return Integer<std::int16_t>();
		case EType::EInt32: return Integer<std::int32_t>();
		case EType::EInt64: return Integer<std::int64_t>();
		case EType::EUInt8: return Integer<std::uint8_t>();
		case EType::EUInt16: return Integer<std::uint16_t>();
		case EType::EUInt32: return Integer<std::uint32_t>();
		case EType::EUInt64: return Integer<std::uint64_t>();
		case EType::EFloat32: NumberText::AppendG(m_Text, m_Bytes.Number<float>(), 9); return true;
		case EType::EFloat64: NumberText::AppendG17(m_Text, m_Bytes.Number<double>()); return true;
		case EType::EString: return Text();
		case EType::EArray: return Elements(*i_rSchema.m_pSubSchema, i_rSchema.m_Count);
		case EType::EList: return Elements(*i_rSchema.m_pSubSchema, m_Bytes.Number<std::uint32_t>());
		case EType::ETuple:
		case EType::ENamedTuple: return Members(i_rSchema);
		case EType::EEnum8: return Enumerator<std::int8_t>(i_rSchema);
		case EType::EEnum16: return Enumerator<std::int16_t>(i_rSchema);
		case EType::EEnum32: return Enumerator<std::int32_t>(i_rSchema);
		}
		return false;
	}

	template <typename T>
	bool Integer()
	{
		m_Text += std::to_string(m_Bytes.Number<T>());
		return true;
	}

	bool Text()
	{
		std::string_view text;
		if (!m_Bytes.Text(text))
		{
			m_Text += "(text is longer than the data)";
			return false;
		}
		((m_Text += '"') += text) += '"';
		return true;
	}

	bool Elements(const ISchema& i_rElement, std::uint32_t i_Count)
	{
		m_Text += '[';
		for (std::uint32_t index = 0; index < i_Count; ++index)
		{
			m_Text += index == 0 ? "" : ", ";
			if (!Value(i_rElement))
				return false;
		}
		m_Text += ']';
		return true;
	}

	bool Members(const ISchema& i_rSchema)
	{
		const bool bNamed = i_rSchema.m_Type == EType::ENamedTuple;
		m_Text += bNamed ? '{' : '(';
		const char* pSeparator = "";
		for (const VSchemaChild& rChild : i_rSchema.m_Children)
		{
			m_Text += std::exchange(pSeparator, ", ");
			if (bNamed)
				(m_Text += rChild.m_Name) += ": ";
			if (!Value(*rChild.m_pSchema))
				return false;
		}
		m_Text += bNamed ? '}' : ')';
		return true;
	}

	template <typename T>
	bool Enumerator(const ISchema& i_rSchema)
	{
		const T value = m_Bytes.Number<T>();
		for (const VSchemaChild& rChild : i_rSchema.m_Children)
			if (T(rChild.m_Value) == value)
			{
				m_Text += rChild.m_Name;
				return true;
			}
		m_Text += std::to_string(value);
		return true;
	}

	NVX::IO::VBinaryReader m_Bytes;
	const std::size_t m_MostBytes;
	std::string m_Text;
};

} // namespace

std::string ValueText(const NVX::IO::VVariant& i_rValue, std::size_t i_MostBytes)
{
	return i_rValue.m_pSchema ? VPrinter(i_rValue.m_Bytes, i_MostBytes).Print(*i_rValue.m_pSchema) : "";
}

} // namespace TesselDataStore
