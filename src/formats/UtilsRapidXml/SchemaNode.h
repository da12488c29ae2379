#pragma once

#include "UtilsRapidXml/Document.h"
#include "UtilsRapidXml/Node.h"

#include <memory>
#include <set>
#include <string>
#include <vector>

namespace UtilsRapidXml
{

/// Describes a format as XML Schema: the format functions run over it once, for each element name. An element is
/// defined by its first declaration, even where two contexts declare it differently; this is also what ends the
/// recursion of elements that hold themselves. The document must outlive the nodes.
class VSchemaNode final : public INode
{
public:
	/// Shared by all nodes of a schema.
	struct VSchemaInfo
	{
		VVersion m_Version;
		/// Names of the elements and of the types that are defined already.
		std::set<std::string, std::less<>> m_Emitted;
		VXmlNode* m_pSchema = nullptr;
		std::size_t m_ErrorCount = 0;
	};

	/// Writes what stands before the elements.
	/// @param i_rSchemaNamespace of the version annotations.
	/// @param i_rStylesheet file name, used with i_bStylesheet only.
	VSchemaNode(VDocument& i_rDocument, bool i_bStylesheet, const std::string& i_rSchemaNamespace,
	    const std::string& i_rStylesheet);
	/// Puts the attributes behind the content model, where the schema language wants them.
	~VSchemaNode() override;
	VSchemaNode(const VSchemaNode&) = delete;
	VSchemaNode& operator=(const VSchemaNode&) = delete;

	std::string_view GetName() const override { return m_Name; }
	void SetVersion(VVersion i_Version) override { m_pInfo->m_Version = i_Version; }
	VVersion GetVersion() const override { return m_pInfo->m_Version; }
	void DeclareEnum(const IEnum& i_rEnum) override;
	void DeclareElement(std::string_view i_Name, std::string_view i_Doc, std::uint32_t i_MinimumCount,
	    std::uint32_t i_MaximumCount, VVersion i_Minimum = {}, VVersion i_Maximum = {}) override;
	void ProcessElements(const std::function<void(INode&)>& i_rCallback, bool i_bChoice = false) override;
	/// @return false always: there is no value.
	bool ProcessAttribute(std::string_view i_Name, std::string_view& o_rText, std::string_view i_Doc,
	    std::string_view i_SchemaType, bool i_bRequired, VVersion i_Minimum = {}, VVersion i_Maximum = {}) override;
	/// Findings about values have no place in a schema; they are only counted.
	void AddError(const std::string&) override { ++m_pInfo->m_ErrorCount; }
	void AddWarning(const std::string&) override {}
	std::size_t GetErrorCount() const override { return m_pInfo->m_ErrorCount; }

private:
	struct VDeclaration
	{
		std::string m_Name;
		std::string m_Doc;
		std::uint32_t m_MinimumCount;
		std::uint32_t m_MaximumCount;
		VVersion m_Minimum;
		VVersion m_Maximum;
	};

	struct VAttribute
	{
		std::string m_Name;
		std::string m_Doc;
		std::string m_Type;
		bool m_bRequired;
		VVersion m_Minimum;
		VVersion m_Maximum;
	};

	VSchemaNode(VDocument& i_rDocument, const VDeclaration& i_rDeclaration, std::shared_ptr<VSchemaInfo> i_pInfo);

	void AppendReference(VXmlNode* i_pPlace, const VDeclaration& i_rDeclaration, bool i_bChoice);
	void AppendAnnotation(VXmlNode* i_pPlace, const std::string& i_rDoc, VVersion i_Minimum, VVersion i_Maximum);

	VDocument& m_rDocument;
	/// Where children go: the complex type of the element, then its sequence. Null at the root, which has none.
	VXmlNode* m_pType = nullptr;
	VXmlNode* m_pSequence = nullptr;
	std::string m_Name;
	std::vector<VDeclaration> m_Pending;
	std::vector<VAttribute> m_Attributes;
	std::shared_ptr<VSchemaInfo> m_pInfo;
};

} // namespace UtilsRapidXml
