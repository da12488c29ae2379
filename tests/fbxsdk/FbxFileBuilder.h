#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <type_traits>
#include <utility>
#include <variant>
#include <vector>

/// Writes small FBX files for tests, the same content in every form of the format.
namespace FbxTest
{

/// Written as a deflated array in binary and as "*n { a: }" in text; before version 7 as a list of values.
using VNumbers = std::vector<double>;
using VIntegers = std::vector<std::int32_t>;
/// Bytes that go into a file as they stand; in a binary one type byte included.
struct VRaw
{
	std::string m_Bytes;
	bool operator==(const VRaw&) const = default;
};
using VTestValue = std::variant<std::int64_t, std::int32_t, double, std::string, VNumbers, VIntegers, VRaw>;

struct VTestRecord
{
	std::string m_Name;
	std::vector<VTestValue> m_Values;
	std::vector<VTestRecord> m_Children;
	/// What a binary file adds to the four numbers of the record's header: end, count and size of values, name's
	/// length.
	std::array<std::uint64_t, 4> m_Lies{};
};

enum class EForm
{
	Binary,
	Text
};

struct VTestForm
{
	const char* m_pName;
	EForm m_Form;
	std::uint32_t m_Version;
};

inline constexpr VTestForm c_Forms[]{{"Binary6100", EForm::Binary, 6100}, {"Binary7400", EForm::Binary, 7400},
    {"Binary7500", EForm::Binary, 7500}, {"Text6100", EForm::Text, 6100}, {"Text7400", EForm::Text, 7400}};

std::string Write(const VTestForm& i_rForm, const std::vector<VTestRecord>& i_rRecords);

struct VTestNode
{
	std::string m_Name;
	/// "LimbNode", "Null" ...
	std::string m_Kind;
	/// Index of the parent, -1 for the scene.
	int m_Parent = -1;
	std::vector<std::pair<std::string, VNumbers>> m_Properties;
};

struct VTestScene
{
	std::vector<VTestNode> m_Nodes;
	std::vector<std::pair<std::string, VNumbers>> m_Settings;
	/// Defaults of all nodes; only version 7 has them.
	std::vector<std::pair<std::string, VNumbers>> m_Template;
	/// Further connections: child and parent by index, -1 for the scene.
	std::vector<std::pair<int, int>> m_Connections;
	std::int64_t m_EncryptionType = 0;
	/// The same of materials.
	std::vector<std::pair<std::string, VNumbers>> m_MaterialTemplate{};
};

inline VTestRecord Record(
    const char* i_pName, std::vector<VTestValue> i_Values, std::vector<VTestRecord> i_Children = {})
{
	return {i_pName, std::move(i_Values), std::move(i_Children)};
}

VTestRecord PropertyList(std::uint32_t i_Version, const std::vector<std::pair<std::string, VNumbers>>& i_rProperties);

/// What connections name a node by: its number, or before version 7 its name. -1 is the scene.
VTestValue NodeKey(const VTestForm& i_rForm, const VTestScene& i_rScene, int i_Node);

/// The records of the scene as that version has them.
std::vector<VTestRecord> Records(const VTestForm& i_rForm, const VTestScene& i_rScene);

inline std::string Write(const VTestForm& i_rForm, const VTestScene& i_rScene)
{
	return Write(i_rForm, Records(i_rForm, i_rScene));
}

/// An array of a binary file that claims this count.
VRaw PackedArray(char i_Type, std::size_t i_Count, bool i_bDeflated, const std::string& i_rNumbers);

/// A zlib stream.
std::string Deflate(const std::string& i_rBytes);

inline void AppendBytes(std::string& io_rBytes, const std::string& i_rText)
{
	io_rBytes += i_rText;
}

template <typename T>
requires std::is_arithmetic_v<T>
void AppendBytes(std::string& io_rBytes, T i_Number)
{
	io_rBytes.append(reinterpret_cast<const char*>(&i_Number), sizeof(T));
}

/// Numbers as the binary form has them, and texts as they are, one behind the other.
template <typename... TParts>
std::string Bytes(const TParts&... i_rParts)
{
	std::string bytes;
	(AppendBytes(bytes, i_rParts), ...);
	return bytes;
}

} // namespace FbxTest
