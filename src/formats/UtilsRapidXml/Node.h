#pragma once

#include "UtilsRapidXml/Enum.h"
#include "UtilsRapidXml/Version.h"

#include <cstddef>
#include <cstdint>
#include <functional>
#include <string>
#include <string_view>

namespace UtilsRapidXml
{

/// Maximum count of a child element that has no limit.
inline constexpr std::uint32_t c_Unbounded = 0xFFFFFFFFu;

/// What a format function sees of the node in hand. The same function reads a file when it is given a VReaderNode
/// and describes the format when it is given a VSchemaNode.
class INode
{
public:
	virtual ~INode() = default;

	virtual std::string_view GetName() const = 0;

	/// Records the file's version in the information that all nodes of the document share.
	virtual void SetVersion(VVersion i_Version) = 0;
	virtual VVersion GetVersion() const = 0;

	/// Makes a type known to the schema; no effect when reading. The table must outlive the document.
	virtual void DeclareEnum(const IEnum& i_rEnum) = 0;

	/// Adds a child element to the pending list. The texts must last until the list is processed.
	virtual void DeclareElement(std::string_view i_Name, std::string_view i_Doc, std::uint32_t i_MinimumCount,
	    std::uint32_t i_MaximumCount, VVersion i_Minimum = {}, VVersion i_Maximum = {}) = 0;

	/// Acts on the pending list, then empties it. With i_bChoice exactly one of the pending elements may stand.
	virtual void ProcessElements(const std::function<void(INode&)>& i_rCallback, bool i_bChoice = false) = 0;

	/// @return true if the attribute's text is in o_rText; it lasts as long as the document.
	virtual bool ProcessAttribute(std::string_view i_Name, std::string_view& o_rText, std::string_view i_Doc,
	    std::string_view i_SchemaType, bool i_bRequired, VVersion i_Minimum = {}, VVersion i_Maximum = {}) = 0;

	virtual void AddError(const std::string& i_rText) = 0;
	virtual void AddWarning(const std::string& i_rText) = 0;
	virtual std::size_t GetErrorCount() const = 0;
};

} // namespace UtilsRapidXml
