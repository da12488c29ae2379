#include "MotionIO/GlbFile.h"

#include <algorithm>
#include <limits>

namespace
{

/// Numbers of one entry.
std::size_t SizeOf(std::string_view i_Type)
{
	return i_Type == "SCALAR" ? 1 : i_Type == "MAT4" ? 16 : std::size_t(i_Type.back() - '0');
}

/// Component types, as the format counts them.
constexpr int c_Byte = 5121;
constexpr int c_Short = 5123;
constexpr int c_Int = 5125;
constexpr int c_Float = 5126;

template <typename T>
std::string_view BytesOf(std::span<const T> i_Numbers)
{
	return {reinterpret_cast<const char*>(i_Numbers.data()), i_Numbers.size_bytes()};
}

void Append(std::string& io_rBytes, std::initializer_list<std::size_t> i_Numbers)
{
	for (const std::size_t number : i_Numbers)
	{
		const auto small = std::uint32_t(number);
		io_rBytes.append(reinterpret_cast<const char*>(&small), sizeof(small));
	}
}

} // namespace

std::size_t MotionIO::VGlbFile::AddView(std::string_view i_Bytes, ETarget i_Target)
{
	// Wherever it begins, its numbers stand at multiples of their size.
	m_Binary.append((4 - m_Binary.size() % 4) % 4, '\0');
	nlohmann::ordered_json& rViews = m_Json["bufferViews"];
	rViews.push_back({{"buffer", 0}, {"byteOffset", m_Binary.size()}, {"byteLength", i_Bytes.size()}});
	if (i_Target != ENone)
		rViews.back()["target"] = int(i_Target);
	m_Binary += i_Bytes;
	return rViews.size() - 1;
}

std::size_t MotionIO::VGlbFile::AddAccessor(
    std::string_view i_Bytes, std::size_t i_Count, int i_Component, const char* i_pType, ETarget i_Target)
{
	const std::size_t view = AddView(i_Bytes, i_Target);
	nlohmann::ordered_json& rAccessors = m_Json["accessors"];
	rAccessors.push_back({{"bufferView", view}, {"componentType", i_Component}, {"count", i_Count}, {"type", i_pType}});
	return rAccessors.size() - 1;
}

std::size_t MotionIO::VGlbFile::AddFloats(
    std::span<const float> i_Numbers, const char* i_pType, ETarget i_Target, bool i_bBounds)
{
	const std::size_t size = SizeOf(i_pType);
	const std::size_t accessor = AddAccessor(BytesOf(i_Numbers), i_Numbers.size() / size, c_Float, i_pType, i_Target);
	if (!i_bBounds)
		return accessor;
	std::vector<float> least(i_Numbers.begin(), i_Numbers.begin() + std::ptrdiff_t(size));
	std::vector<float> greatest = least;
	for (std::size_t i = 0; i < i_Numbers.size(); ++i)
	{
		least[i % size] = std::min(least[i % size], i_Numbers[i]);
		greatest[i % size] = std::max(greatest[i % size], i_Numbers[i]);
	}
	m_Json["accessors"].back()["min"] = least;
	m_Json["accessors"].back()["max"] = greatest;
	return accessor;
}

std::size_t MotionIO::VGlbFile::AddBytes(std::span<const std::uint8_t> i_Numbers, const char* i_pType, ETarget i_Target)
{
	return AddAccessor(BytesOf(i_Numbers), i_Numbers.size() / SizeOf(i_pType), c_Byte, i_pType, i_Target);
}

std::size_t MotionIO::VGlbFile::AddIndices(std::span<const std::uint8_t> i_Bytes, std::uint32_t i_IndexSize)
{
	return AddAccessor(
	    BytesOf(i_Bytes), i_Bytes.size() / i_IndexSize, i_IndexSize == 2 ? c_Short : c_Int, "SCALAR", EIndices);
}

bool MotionIO::VGlbFile::Finish(std::string& o_rBytes)
{
	m_Binary.append((4 - m_Binary.size() % 4) % 4, '\0');
	m_Json["buffers"] = nlohmann::ordered_json::array({{{"byteLength", m_Binary.size()}}});
	// Names are bytes of a file.
	std::string json = m_Json.dump(-1, ' ', false, nlohmann::ordered_json::error_handler_t::replace);
	json.append((4 - json.size() % 4) % 4, ' ');
	const std::size_t size = 12 + 8 + json.size() + 8 + m_Binary.size();
	if (size > std::numeric_limits<std::uint32_t>::max())
		return false;
	o_rBytes = "glTF";
	o_rBytes.reserve(size);
	Append(o_rBytes, {2, size, json.size()});
	o_rBytes.append("JSON").append(json);
	Append(o_rBytes, {m_Binary.size()});
	o_rBytes.append("BIN\0", 4).append(m_Binary);
	return true;
}
