#include "fbxsdk/container/RecordWriter.h"

#include "fbxsdk/Limits.h"
#include "fbxsdk/container/FileKind.h"
#include "math/NumberText.h"

#include <cstring>

namespace
{

using namespace FbxFormat;

/// End, count of values, size of values and length of the name, before version 7.5.
constexpr std::size_t c_HeaderSize = 13;

template <typename T>
void AppendBytes(std::string& io_rBytes, char i_Type, T i_Value)
{
	io_rBytes += i_Type;
	io_rBytes.append(reinterpret_cast<const char*>(&i_Value), sizeof(i_Value));
}

void AppendBinary(std::string& io_rBytes, const VWrittenValue& i_rValue)
{
	if (const auto* const pInteger = std::get_if<std::int64_t>(&i_rValue))
		AppendBytes(io_rBytes, 'L', *pInteger);
	else if (const auto* const pReal = std::get_if<double>(&i_rValue))
		AppendBytes(io_rBytes, 'D', *pReal);
	else
	{
		const auto text = std::get<std::string_view>(i_rValue);
		AppendBytes(io_rBytes, 'S', std::uint32_t(text.size()));
		io_rBytes += text;
	}
}

void AppendText(std::string& io_rBytes, const VWrittenValue& i_rValue)
{
	if (!io_rBytes.empty())
		io_rBytes += ',';
	if (const auto* const pInteger = std::get_if<std::int64_t>(&i_rValue))
		io_rBytes += std::to_string(*pInteger);
	else if (const auto* const pReal = std::get_if<double>(&i_rValue))
		NumberText::AppendG17(io_rBytes, *pReal);
	else
		((io_rBytes += '"') += std::get<std::string_view>(i_rValue)) += '"';
}

} // namespace

FbxFormat::VRecordWriter::VRecordWriter(const VElementTree& i_rSource)
    : m_rSource(i_rSource), m_bText(i_rSource.Size() > 1 && i_rSource[1].m_Form != EValueForm::Binary),
      m_Bytes(m_bText ? 0 : c_BinaryHeaderSize, '\0')
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
		const std::uint32_t header[3]{0, i_Count, std::uint32_t(i_Values.size())};
		m_Bytes.append(reinterpret_cast<const char*>(header), sizeof(header));
		((m_Bytes += char(i_Name.size())) += i_Name) += i_Values;
	}
	return true;
}

void FbxFormat::VRecordWriter::End(std::size_t i_Record)
{
	const auto end = std::uint32_t(m_Bytes.size());
	if (!m_bText)
		std::memcpy(m_Bytes.data() + i_Record, &end, sizeof(end));
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
		m_Bytes.append(c_HeaderSize, '\0');
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
	if (i_Element != c_NoElement && Begin(i_Name, m_rSource.Values(i_Element), m_rSource[i_Element].m_ValueCount))
		End(record);
}

std::string FbxFormat::VRecordWriter::Finish()
{
	if (!m_bText)
		m_Bytes.append(c_HeaderSize, '\0');
	return std::move(m_Bytes);
}
