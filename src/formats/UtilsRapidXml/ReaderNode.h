#pragma once

#include "UtilsRapidXml/Document.h"
#include "UtilsRapidXml/Messages.h"
#include "UtilsRapidXml/Node.h"

#include <memory>
#include <memory_resource>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace UtilsRapidXml
{

/// Reads a document through format functions. What they do not ask for is told as a warning when the node goes, so
/// that a later version's additions are passed over with a word. Nodes live for the length of one callback, and the
/// document must outlive them. Nothing is thrown for what a file holds.
class VReaderNode final : public INode
{
	struct VDeclaration
	{
		std::string_view m_Name;
		std::uint32_t m_MinimumCount;
		std::uint32_t m_MaximumCount;
		VVersion m_Minimum;
		VVersion m_Maximum;
	};

	struct VMatch
	{
		std::size_t m_Position;
		VXmlNode* m_pElement;
	};

	/// What a node notes while it lives. Nodes come and go by the thousands, so that they pass these on.
	struct VNotes
	{
		std::vector<VDeclaration> m_Pending;
		std::vector<VMatch> m_Matches;
		/// Names of children that stand in the file and were declared or already told of; they point into the document.
		std::vector<std::string_view> m_RecognisedChildren;
		/// Where the names of the attributes begin that were asked for: no two attributes of an element have one name.
		std::vector<const char*> m_RecognisedAttributes;
	};

public:
	/// Shared by all nodes of a document; what the owner reads after the walk.
	struct VGlobalInfo
	{
		VVersion m_Version;
		VMessages m_Errors;
		VMessages m_Warnings;
		/// Takes the place of m_Warnings, if that is wanted, for attributes that belong to XML itself and for an ID
		/// that elements of two kinds share, each of which is looked up among its own kind.
		VMessages m_Details;
		bool m_bOwnFormsAreDetails = false;
		bool m_bStrictOrder = false;
		/// What a node was to tell when it went is missing: the reader is to throw std::bad_alloc, which a node could
		/// not.
		bool m_bOutOfMemory = false;
		/// The values of all xsd:ID attributes read so far, with the names of the elements that had them last; both
		/// point into the document.
		std::pmr::monotonic_buffer_resource m_IdMemory;
		std::pmr::unordered_map<std::string_view, std::string_view> m_Ids{&m_IdMemory};
		std::vector<std::unique_ptr<VNotes>> m_SpareNotes;
	};

	/// The node above the document's elements. With strict order children must stand in the order of declaration.
	VReaderNode(VDocument& i_rDocument, bool i_bStrictOrder);
	~VReaderNode() override;
	VReaderNode(const VReaderNode&) = delete;
	VReaderNode& operator=(const VReaderNode&) = delete;

	const std::shared_ptr<VGlobalInfo>& GetGlobalInfo() const { return m_pGlobal; }

	std::string_view GetName() const override;
	void SetVersion(VVersion i_Version) override { m_pGlobal->m_Version = i_Version; }
	VVersion GetVersion() const override { return m_pGlobal->m_Version; }
	void DeclareEnum(const IEnum&) override {}
	void DeclareElement(std::string_view i_Name, std::string_view i_Doc, std::uint32_t i_MinimumCount,
	    std::uint32_t i_MaximumCount, VVersion i_Minimum = {}, VVersion i_Maximum = {}) override;
	void ProcessElements(const std::function<void(INode&)>& i_rCallback, bool i_bChoice = false) override;
	bool ProcessAttribute(std::string_view i_Name, std::string_view& o_rText, std::string_view i_Doc,
	    std::string_view i_SchemaType, bool i_bRequired, VVersion i_Minimum = {}, VVersion i_Maximum = {}) override;
	void AddError(const std::string& i_rText) override { m_pGlobal->m_Errors.Add(i_rText); }
	void AddWarning(const std::string& i_rText) override { m_pGlobal->m_Warnings.Add(i_rText); }
	std::size_t GetErrorCount() const override { return m_pGlobal->m_Errors.GetCount(); }

private:
	VReaderNode(VXmlNode* i_pElement, std::shared_ptr<VGlobalInfo> i_pGlobal);

	/// The one of that name, null if there is none. What is found counts as recognised.
	const VXmlAttribute* FindAttribute(std::string_view i_Name);
	void TellIgnored();
	void Match(const VDeclaration& i_rDeclaration, bool i_bChoice, std::string& io_rChosen);

	VXmlNode* m_pElement;
	std::shared_ptr<VGlobalInfo> m_pGlobal;
	std::unique_ptr<VNotes> m_pNotes;
	std::size_t m_HighestPosition = 0;
	/// One bit for each attribute of the element, by its name: most that are asked for are not there.
	std::uint64_t m_AttributeBits = 0;
	/// Behind the attribute that was found last.
	const VXmlAttribute* m_pNextAttribute;
};

} // namespace UtilsRapidXml
