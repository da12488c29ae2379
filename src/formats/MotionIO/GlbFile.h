#pragma once

#include <nlohmann/json.hpp>

#include <cstdint>
#include <span>
#include <string>
#include <string_view>

namespace MotionIO
{

/// The two parts of a glTF binary file: its JSON, and the bytes that its accessors and images lie in.
class VGlbFile
{
public:
	nlohmann::ordered_json m_Json{{"asset", {{"version", "2.0"}, {"generator", "retarget"}}}};

	/// What a buffer view is for, as the format counts it.
	enum ETarget
	{
		ENone = 0,
		EVertices = 34962,
		EIndices = 34963
	};

	/// Adds numbers as an accessor; one of "SCALAR", "VEC2", "VEC3", "VEC4" and "MAT4", of which there are so many.
	/// @param i_bBounds adds their least and greatest
	/// @return its index
	std::size_t AddFloats(
	    std::span<const float> i_Numbers, const char* i_pType, ETarget i_Target = ENone, bool i_bBounds = false);
	std::size_t AddBytes(std::span<const std::uint8_t> i_Numbers, const char* i_pType, ETarget i_Target);
	/// Indices of 2 or 4 bytes each.
	std::size_t AddIndices(std::span<const std::uint8_t> i_Bytes, std::uint32_t i_IndexSize);

	/// Adds bytes as a buffer view, and gives its index.
	std::size_t AddView(std::string_view i_Bytes, ETarget i_Target = ENone);

	/// The whole file; false if it is larger than the format holds.
	bool Finish(std::string& o_rBytes);

private:
	std::size_t AddAccessor(
	    std::string_view i_Bytes, std::size_t i_Count, int i_Component, const char* i_pType, ETarget i_Target);

	std::string m_Binary;
};

} // namespace MotionIO
