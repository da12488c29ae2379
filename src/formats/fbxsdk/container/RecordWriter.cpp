#include "fbxsdk/container/RecordWriter.h"

#include "fbxsdk/Limits.h"
#include "fbxsdk/container/FileKind.h"
#include "fbxsdk/container/Lent.h"
#include "math/NumberText.h"

#include <libdeflate.h>

#include <cstring>
#include <type_traits>

namespace
{

using namespace FbxFormat;

template <typename T>
void AppendBytes(std::string& io_rBytes, char i_Type, T i_Value)
{
	io_rBytes += i_Type;
	io_rBytes.append(reinterpret_cast<const char*>(&i_Value), sizeof(i_Value));
}

/// The letter of a number, and in lower case that of an array of such.
template <typename T>
constexpr char c_Letter = std::is_same_v<T, double> ? 'D'
    : std::is_same_v<T, float>                      ? 'F'
    : sizeof(T) == 4                                ? 'I'
                                                    : 'L';

/// Below this, what deflating adds is more than it saves.
constexpr std::size_t c_LeastDeflated = 128;

libdeflate_compressor* MakeCompressor()
{
	return libdeflate_alloc_compressor(6);
}

template <typename T>
void AppendArray(std::string& io_rBytes, std::span<const T> i_Numbers)
{
	const std::size_t size = i_Numbers.size_bytes();
	const bool bDeflate = size >= c_LeastDeflated;
	std::string deflated;
	if (bDeflate)
	{
		const VLent<MakeCompressor, libdeflate_free_compressor> compressor;
		deflated.resize(libdeflate_zlib_compress_bound(compressor.Get(), size));
		deflated.resize(
		    libdeflate_zlib_compress(compressor.Get(), i_Numbers.data(), size, deflated.data(), deflated.size()));
	}
	const std::uint32_t header[3]{
	    std::uint32_t(i_Numbers.size()), bDeflate ? 1u : 0u, std::uint32_t(bDeflate ? deflated.size() : size)};
	io_rBytes += char(c_Letter<T> - 'A' + 'a');
	io_rBytes.append(reinterpret_cast<const char*>(header), sizeof(header));
	if (bDeflate)
		io_rBytes += deflated;
	else
		io_rBytes.append(reinterpret_cast<const char*>(i_Numbers.data()), size);
}

void AppendBinary(std::string& io_rBytes, const VWrittenValue& i_rValue)
{
	std::visit(
	    [&io_rBytes]<typename T>(const T& i_rAny)
	    {
		    if constexpr (std::is_arithmetic_v<T>)
			    AppendBytes(io_rBytes, c_Letter<T>, i_rAny);
		    else if constexpr (std::is_same_v<T, std::string_view>)
		    {
			    AppendBytes(io_rBytes, 'S', std::uint32_t(i_rAny.size()));
			    io_rBytes += i_rAny;
		    }
		    else
			    AppendArray(io_rBytes, i_rAny);
	    },
	    i_rValue);
}

void AppendNumber(std::string& io_rBytes, double i_Number)
{
	NumberText::AppendG17(io_rBytes, i_Number);
}

void AppendNumber(std::string& io_rBytes, std::int64_t i_Number)
{
	io_rBytes += std::to_string(i_Number);
}

void AppendText(std::string& io_rBytes, const VWrittenValue& i_rValue)
{
	if (!io_rBytes.empty())
		io_rBytes += ',';
	const auto number = [&io_rBytes]<typename T>(T i_Number)
	{ AppendNumber(io_rBytes, std::conditional_t<std::is_floating_point_v<T>, double, std::int64_t>(i_Number)); };
	std::visit(
	    [&]<typename T>(const T& i_rAny)
	    {
		    if constexpr (std::is_arithmetic_v<T>)
			    number(i_rAny);
		    else if constexpr (std::is_same_v<T, std::string_view>)
			    ((io_rBytes += '"') += i_rAny) += '"';
		    else
			    for (std::size_t i = 0; i < i_rAny.size(); ++i)
			    {
				    io_rBytes += i > 0 ? "," : "";
				    number(i_rAny[i]);
			    }
	    },
	    i_rValue);
}

} // namespace

FbxFormat::VRecordWriter::VRecordWriter(const VElementTree& i_rSource)
    : m_pSource(&i_rSource), m_bText(i_rSource.Size() > 1 && i_rSource[1].m_Form != EValueForm::Binary), m_bWide(false),
      m_Place(0), m_Bytes(m_bText ? 0 : c_BinaryHeaderSize, '\0')
{
}

FbxFormat::VRecordWriter::VRecordWriter(std::uint32_t i_Version, std::size_t i_Place)
    : m_pSource(nullptr), m_bText(false), m_bWide(i_Version >= c_FirstWideVersion), m_Place(i_Place)
{
}

bool FbxFormat::VRecordWriter::Begin(std::string_view i_Name, std::string_view i_Values, std::uint32_t i_Count)
{
	// One more than is read, so that its reader knows.
	if (m_Records > Limits::c_Records)
		return false;
	++m_Records;
	if (m_bText)
		(((m_Bytes += i_Name) += ": ") += i_Values) += '\n';
	else
	{
		// Where it ends is known at its end.
		if (const std::uint64_t wide[3]{0, i_Count, i_Values.size()}; m_bWide)
			m_Bytes.append(reinterpret_cast<const char*>(wide), sizeof(wide));
		else
			for (const std::uint64_t number : wide)
				m_Bytes.append(reinterpret_cast<const char*>(&number), 4);
		((m_Bytes += char(i_Name.size())) += i_Name) += i_Values;
	}
	return true;
}

void FbxFormat::VRecordWriter::End(std::size_t i_Record)
{
	const std::uint64_t end = m_Place + m_Bytes.size();
	if (!m_bText)
		std::memcpy(m_Bytes.data() + i_Record, &end, m_bWide ? 8 : 4);
}

void FbxFormat::VRecordWriter::Open(std::string_view i_Name, std::initializer_list<VWrittenValue> i_Values)
{
	m_Open.push_back(m_Bytes.size());
	std::string values;
	for (const VWrittenValue& rValue : i_Values)
		(m_bText ? AppendText : AppendBinary)(values, rValue);
	if (!Begin(i_Name, values, std::uint32_t(i_Values.size())))
		m_Open.back() = std::string::npos;
	else if (m_bText)
		m_Bytes += "{\n";
}

void FbxFormat::VRecordWriter::Close()
{
	const std::size_t record = m_Open.back();
	m_Open.pop_back();
	if (record == std::string::npos)
		return;
	if (m_bText)
		m_Bytes += "}\n";
	else
		m_Bytes.append(RecordHeaderSize(m_bWide), '\0');
	End(record);
}

void FbxFormat::VRecordWriter::Add(std::string_view i_Name, std::initializer_list<VWrittenValue> i_Values)
{
	const std::size_t record = m_Bytes.size();
	std::string values;
	for (const VWrittenValue& rValue : i_Values)
		(m_bText ? AppendText : AppendBinary)(values, rValue);
	if (Begin(i_Name, values, std::uint32_t(i_Values.size())))
		End(record);
}

void FbxFormat::VRecordWriter::Copy(std::string_view i_Name, VElementIndex i_Element)
{
	const std::size_t record = m_Bytes.size();
	if (i_Element != c_NoElement && Begin(i_Name, m_pSource->Values(i_Element), (*m_pSource)[i_Element].m_ValueCount))
		End(record);
}

std::string FbxFormat::VRecordWriter::Finish()
{
	if (!m_bText && m_pSource)
		m_Bytes.append(RecordHeaderSize(m_bWide), '\0');
	return std::move(m_Bytes);
}
