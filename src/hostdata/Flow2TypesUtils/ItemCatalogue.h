#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <string_view>

namespace Flow2TypesUtils
{

/// What the items of one flow type carry.
enum class EItemValue
{
	ESubject,
	ESubjectParametrised,
	ESubjectApplicationData,
	ESubjectDynamicParameters,
	ESubjectSettings,
	EReconstructionLabelSet,
	/// Types of the host's other panels, whose bytes are passed on unread.
	EBytes
};

/// One type of item of the host's flow. The tag identifies it, and so does the name; texts may be alike.
struct VItemDescriptor
{
	/// For people.
	std::string m_Text;
	/// The flow type: "FlowSubject", ...
	std::string m_Name;
	std::uint32_t m_Tag = 0;
	std::uint32_t m_Version = 1;
	std::uint32_t m_Count = 0;
	EItemValue m_Value = EItemValue::EBytes;
};

/// All item types that have a tag, in its order. Made at the first call, from whatever thread.
std::span<const VItemDescriptor> ItemCatalogue();

/// Null for a tag or a name that the catalogue does not have.
const VItemDescriptor* FindItemType(std::uint32_t i_Tag);
const VItemDescriptor* FindItemType(std::string_view i_Name);

} // namespace Flow2TypesUtils
