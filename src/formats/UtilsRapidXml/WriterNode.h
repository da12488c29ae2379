#pragma once

#include "UtilsRapidXml/Messages.h"
#include "UtilsRapidXml/Version.h"

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
	std::string_view GetName() const { return m_Name; }
	void SetVersion(VVersion i_Version) { m_pGlobal->m_Version = i_Version; }
	VVersion GetVersion() const { return m_pGlobal->m_Version; }
	void AddError(const std::string& i_rText) { m_pGlobal->m_Errors.Add(i_rText); }

	/// @return false, with nothing written, if the version is set and out of range, or (with an error added) if the
	/// text has bytes that XML cannot hold. Attributes stand in the order of the calls, behind children too, which
	/// costs a move of these.
	bool WriteAttribute(
	    std::string_view i_Name, std::string_view i_Text, VVersion i_Minimum = {}, VVersion i_Maximum = {});

	/// Writes an attribute of the version being written whose value i_rAppend puts at the end of a text: numbers, and
	/// other bytes that stand for themselves between quotes. The document itself has no attributes.
	template <typename TAppend>
	void WriteAttributeInPlace(std::string_view i_Name, const TAppend& i_rAppend)
	{
		if (m_Depth == 0)
			return;
		const std::size_t begin = m_rText.size();
		((m_rText += ' ') += i_Name) += "=\"";
		i_rAppend(m_rText);
		m_rText += '"';
		EndAttribute(begin);
	}

	/// Makes a child at the end of the list and calls i_rCallback(child). The name must live until that has returned.
	/// @return false, without a call, if the version is set and out of range, or (with an error added) if the child
	/// would be nested deeper than the reader allows.
	template <typename TCallback>
	bool WriteElement(
	    std::string_view i_Name, const TCallback& i_rCallback, VVersion i_Minimum = {}, VVersion i_Maximum = {})
	{
		if (!BeginChild(i_Name, i_Minimum, i_Maximum))
			return false;
		VWriterNode child(m_rText, i_Name, m_Depth + 1, m_pGlobal);
		child.Open();
		i_rCallback(child);
		child.Close();
		return true;
	}

private:
	VWriterNode(
	    std::string& io_rText, std::string_view i_Name, std::size_t i_Depth, std::shared_ptr<VGlobalInfo> i_pGlobal);

	bool BeginChild(std::string_view i_Name, VVersion i_Minimum, VVersion i_Maximum);
	void Open();
	/// Brings what stands from here on to the other attributes.
	void EndAttribute(std::size_t i_Begin);
	void Close();

	std::string& m_rText;
	std::string_view m_Name;
	std::size_t m_Depth;
	std::shared_ptr<VGlobalInfo> m_pGlobal;
	/// Behind the last attribute. What follows are children, if there are any.
	std::size_t m_AttributesEnd = 0;
	bool m_bHasChildren = false;
};

} // namespace UtilsRapidXml
