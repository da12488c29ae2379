#pragma once

#include "UtilsRapidXml/Messages.h"
#include "UtilsRapidXml/Version.h"

#include <functional>
#include <memory>
#include <string>
#include <string_view>

namespace UtilsRapidXml
{

/// Writes a document from the top. What the version being written does not have is left out. Nodes live for the length
/// of one callback, in which they and no other write.
class VWriterNode
{
public:
	/// Shared by all nodes of a document.
	struct VGlobalInfo
	{
		VVersion m_Version;
		VMessages m_Errors;
	};

	/// The node above the document's elements. It begins the text anew, with the declaration; the text must outlive it.
	explicit VWriterNode(std::string& o_rText);

	const std::shared_ptr<VGlobalInfo>& GetGlobalInfo() const { return m_pGlobal; }
	const std::string& GetName() const { return m_Name; }
	void SetVersion(VVersion i_Version) { m_pGlobal->m_Version = i_Version; }
	VVersion GetVersion() const { return m_pGlobal->m_Version; }
	void AddError(const std::string& i_rText) { m_pGlobal->m_Errors.Add(i_rText); }

	/// @return false, with nothing written, if the version is set and out of range, or (with an error added) if the
	/// text has bytes that XML cannot hold. Attributes stand in the order of the calls, behind children too, which
	/// costs a move of these.
	bool WriteAttribute(
	    std::string_view i_Name, std::string_view i_Text, VVersion i_Minimum = {}, VVersion i_Maximum = {});

	/// Makes a child at the end of the list and calls the callback with it.
	/// @return false, without a call, if the version is set and out of range, or (with an error added) if the child
	/// would be nested deeper than the reader allows.
	bool WriteElement(std::string_view i_Name, const std::function<void(VWriterNode&)>& i_rCallback,
	    VVersion i_Minimum = {}, VVersion i_Maximum = {});

private:
	VWriterNode(
	    std::string& io_rText, std::string_view i_Name, std::size_t i_Depth, std::shared_ptr<VGlobalInfo> i_pGlobal);

	void Open();
	void Close();

	std::string& m_rText;
	std::string m_Name;
	std::size_t m_Depth;
	std::shared_ptr<VGlobalInfo> m_pGlobal;
	/// Behind the last attribute. What follows are children, if there are any.
	std::size_t m_AttributesEnd = 0;
	bool m_bHasChildren = false;
};

} // namespace UtilsRapidXml
