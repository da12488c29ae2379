#include "FbxFileBuilder.h"

#include "math/NumberText.h"

#include <libdeflate.h>

#include <memory>

using namespace FbxTest;

namespace
{

template <typename T>
std::string BinaryArray(char i_Type, const std::vector<T>& i_rNumbers)
{
	return PackedArray(i_Type, i_rNumbers.size(), true,
	    {reinterpret_cast<const char*>(i_rNumbers.data()), sizeof(T) * i_rNumbers.size()})
	    .m_Bytes;
}

std::string BinaryValue(const VTestValue& i_rValue)
{
	if (const auto* const pInteger = std::get_if<std::int64_t>(&i_rValue))
		return Bytes('L', *pInteger);
	if (const auto* const pShort = std::get_if<std::int32_t>(&i_rValue))
		return Bytes('I', *pShort);
	if (const auto* const pReal = std::get_if<double>(&i_rValue))
		return Bytes('D', *pReal);
	if (const auto* const pRaw = std::get_if<VRaw>(&i_rValue))
		return pRaw->m_Bytes;
	if (const auto* const pNumbers = std::get_if<VNumbers>(&i_rValue))
		return BinaryArray('d', *pNumbers);
	if (const auto* const pIntegers = std::get_if<VIntegers>(&i_rValue))
		return BinaryArray('i', *pIntegers);
	std::string text = std::get<std::string>(i_rValue);
	if (const std::size_t at = text.find("::"); at != std::string::npos)
		text = text.substr(at + 2) + std::string("\0\1", 2) + text.substr(0, at);
	return Bytes('S', std::uint32_t(text.size()), text);
}

/// Before version 7 an array is a list of values.
/// @return how many; 0 if it is no array.
std::size_t WriteList(const VTestValue& i_rValue, std::string& io_rBytes)
{
	const auto write = [&](const auto* i_pNumbers) -> std::size_t
	{
		if (!i_pNumbers)
			return 0;
		for (const auto number : *i_pNumbers)
			io_rBytes += BinaryValue(number);
		return i_pNumbers->size();
	};
	return write(std::get_if<VNumbers>(&i_rValue)) + write(std::get_if<VIntegers>(&i_rValue));
}

class VBinaryWriter
{
public:
	explicit VBinaryWriter(std::uint32_t i_Version) : m_Version(i_Version)
	{
		m_Bytes = Bytes(std::string("Kaydara FBX Binary  \0\x1a\0", 23), i_Version);
	}

	void Write(const VTestRecord& i_rRecord)
	{
		std::string values;
		std::size_t count = 0;
		for (const VTestValue& rValue : i_rRecord.m_Values)
		{
			const std::size_t before = count;
			if (m_Version < 7000)
				count += WriteList(rValue, values);
			if (count != before)
				continue;
			values += BinaryValue(rValue);
			++count;
		}
		const std::size_t start = m_Bytes.size();
		const auto& [endLie, countLie, sizeLie, nameLie] = i_rRecord.m_Lies;
		Header(0, count + countLie, values.size() + sizeLie, i_rRecord.m_Name, char(nameLie));
		m_Bytes += values;
		for (const VTestRecord& rChild : i_rRecord.m_Children)
			Write(rChild);
		if (!i_rRecord.m_Children.empty())
			Header(0, 0, 0, {});
		const std::string end = Number(m_Bytes.size() + endLie);
		m_Bytes.replace(start, end.size(), end);
	}

	std::string Finish()
	{
		Header(0, 0, 0, {});
		// In the place of the footer's fixed bytes.
		return m_Bytes + std::string(40, '\x5a');
	}

private:
	std::string Number(std::size_t i_Number) const
	{
		return m_Version >= 7500 ? Bytes(std::uint64_t(i_Number)) : Bytes(std::uint32_t(i_Number));
	}

	void Header(
	    std::size_t i_End, std::size_t i_Count, std::size_t i_Size, const std::string& i_rName, char i_NameLie = 0)
	{
		m_Bytes +=
		    Bytes(Number(i_End), Number(i_Count), Number(i_Size), char(int(i_rName.size()) + i_NameLie), i_rName);
	}

	std::uint32_t m_Version;
	std::string m_Bytes;
};

template <typename T>
std::string Joined(const std::vector<T>& i_rNumbers)
{
	std::string text;
	for (const T number : i_rNumbers)
	{
		text += text.empty() ? "" : ",";
		NumberText::AppendG17(text, number);
	}
	return text;
}

void WriteText(
    std::uint32_t i_Version, const VTestRecord& i_rRecord, const std::string& i_rIndent, std::string& io_rText)
{
	io_rText += i_rIndent + i_rRecord.m_Name + ": ";
	const auto array = [&](const auto& i_rNumbers, std::size_t i_Count)
	{
		const std::string numbers = Joined(i_rNumbers);
		return i_Version < 7000 ? numbers
		                        : "*" + std::to_string(i_Count) + " {\n" + i_rIndent + "\ta: " + numbers + "\n}";
	};
	std::string separator;
	for (const VTestValue& rValue : i_rRecord.m_Values)
	{
		io_rText += separator;
		separator = ", ";
		if (const auto* const pInteger = std::get_if<std::int64_t>(&rValue))
			io_rText += std::to_string(*pInteger);
		else if (const auto* const pShort = std::get_if<std::int32_t>(&rValue))
			io_rText += std::to_string(*pShort);
		else if (const auto* const pReal = std::get_if<double>(&rValue))
			io_rText += NumberText::PrintG17(*pReal);
		else if (const auto* const pNumbers = std::get_if<VNumbers>(&rValue))
			io_rText += array(*pNumbers, pNumbers->size());
		else if (const auto* const pIntegers = std::get_if<VIntegers>(&rValue))
			io_rText += array(*pIntegers, pIntegers->size());
		else if (const auto* const pText = std::get_if<std::string>(&rValue))
			io_rText += '"' + *pText + '"';
		else
			io_rText += std::get<VRaw>(rValue).m_Bytes;
	}
	if (!i_rRecord.m_Children.empty())
	{
		io_rText += " {\n";
		for (const VTestRecord& rChild : i_rRecord.m_Children)
			WriteText(i_Version, rChild, i_rIndent + '\t', io_rText);
		io_rText += i_rIndent + "}";
	}
	io_rText += '\n';
}

} // namespace

std::string FbxTest::Write(const VTestForm& i_rForm, const std::vector<VTestRecord>& i_rRecords)
{
	if (i_rForm.m_Form == EForm::Binary)
	{
		VBinaryWriter writer(i_rForm.m_Version);
		for (const VTestRecord& rRecord : i_rRecords)
			writer.Write(rRecord);
		return writer.Finish();
	}
	std::string text = "; FBX " + std::to_string(i_rForm.m_Version / 1000) + '.'
	    + std::to_string(i_rForm.m_Version / 100 % 10) + ".0 project file\n";
	for (const VTestRecord& rRecord : i_rRecords)
		WriteText(i_rForm.m_Version, rRecord, {}, text);
	return text;
}

VTestRecord FbxTest::PropertyList(
    std::uint32_t i_Version, const std::vector<std::pair<std::string, VNumbers>>& i_rProperties)
{
	const bool bNew = i_Version >= 7000;
	VTestRecord list = Record(bNew ? "Properties70" : "Properties60", {});
	for (const auto& [name, numbers] : i_rProperties)
	{
		std::vector<VTestValue> values{name, std::string("Type"), std::string()};
		if (bNew)
			values.push_back(std::string("A+"));
		values.insert(values.end(), numbers.begin(), numbers.end());
		list.m_Children.push_back(Record(bNew ? "P" : "Property", std::move(values)));
	}
	return list;
}

VTestValue FbxTest::NodeKey(const VTestForm& i_rForm, const VTestScene& i_rScene, int i_Node)
{
	if (i_rForm.m_Version >= 7000)
		return std::int64_t(i_Node + 1);
	return "Model::" + (i_Node < 0 ? "Scene" : i_rScene.m_Nodes[i_Node].m_Name);
}

std::vector<VTestRecord> FbxTest::Records(const VTestForm& i_rForm, const VTestScene& i_rScene)
{
	const bool bNew = i_rForm.m_Version >= 7000;
	VTestRecord objects = Record("Objects", {});
	VTestRecord connections = Record("Connections", {});
	const auto connect = [&](VTestValue i_Child, VTestValue i_Parent)
	{
		connections.m_Children.push_back(
		    Record(bNew ? "C" : "Connect", {std::string("OO"), std::move(i_Child), std::move(i_Parent)}));
	};
	const auto key = [&](int i_Node) { return NodeKey(i_rForm, i_rScene, i_Node); };
	for (int i = 0; i < int(i_rScene.m_Nodes.size()); ++i)
	{
		const VTestNode& rNode = i_rScene.m_Nodes[i];
		VTestRecord node = Record(
		    "Model", {"Model::" + rNode.m_Name, rNode.m_Kind}, {PropertyList(i_rForm.m_Version, rNode.m_Properties)});
		if (bNew)
		{
			const std::int64_t attribute = 1'000'000 + i;
			node.m_Values.insert(node.m_Values.begin(), key(i));
			objects.m_Children.push_back(
			    Record("NodeAttribute", {attribute, std::string("NodeAttribute::"), rNode.m_Kind}));
			connect(attribute, key(i));
		}
		objects.m_Children.push_back(node);
		connect(key(i), key(rNode.m_Parent));
	}
	for (const auto& [child, parent] : i_rScene.m_Connections)
		connect(key(child), key(parent));

	const VTestRecord settings = Record("GlobalSettings", {}, {PropertyList(i_rForm.m_Version, i_rScene.m_Settings)});
	std::vector<VTestRecord> records{Record("FBXHeaderExtension", {},
	    {Record("FBXVersion", {std::int32_t(i_rForm.m_Version)}),
	        Record("EncryptionType", {std::int32_t(i_rScene.m_EncryptionType)})})};
	if (bNew)
	{
		const VTestRecord defaults = Record(
		    "PropertyTemplate", {std::string("FbxNode")}, {PropertyList(i_rForm.m_Version, i_rScene.m_Template)});
		records.push_back(Record("Definitions", {}, {Record("ObjectType", {std::string("Model")}, {defaults})}));
		if (!i_rScene.m_MaterialTemplate.empty())
			records.back().m_Children.push_back(Record("ObjectType", {std::string("Material")},
			    {Record("PropertyTemplate", {std::string("FbxSurfacePhong")},
			        {PropertyList(i_rForm.m_Version, i_rScene.m_MaterialTemplate)})}));
		records.push_back(settings);
	}
	else
		objects.m_Children.push_back(settings);
	records.push_back(objects);
	records.push_back(connections);
	return records;
}

VRaw FbxTest::PackedArray(char i_Type, std::size_t i_Count, bool i_bDeflated, const std::string& i_rNumbers)
{
	const std::string packed = i_bDeflated ? Deflate(i_rNumbers) : i_rNumbers;
	return {Bytes(i_Type, std::uint32_t(i_Count), std::uint32_t(i_bDeflated), std::uint32_t(packed.size()), packed)};
}

std::string FbxTest::Deflate(const std::string& i_rBytes)
{
	const std::unique_ptr<libdeflate_compressor, decltype(&libdeflate_free_compressor)> pCompressor(
	    libdeflate_alloc_compressor(6), &libdeflate_free_compressor);
	std::string deflated(libdeflate_zlib_compress_bound(pCompressor.get(), i_rBytes.size()), '\0');
	deflated.resize(libdeflate_zlib_compress(
	    pCompressor.get(), i_rBytes.data(), i_rBytes.size(), deflated.data(), deflated.size()));
	return deflated;
}
