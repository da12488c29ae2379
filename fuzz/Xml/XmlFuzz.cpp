#include "../Require.h"
#include "../XmlTree.h"

#include "UtilsRapidXml/Attributes.h"
#include "UtilsRapidXml/ReaderNode.h"

#include <cstdint>
#include <string>

namespace
{

using namespace UtilsRapidXml;

/// A format in which everything that a format function may ask for happens, at every level.
void Node(INode& io_rNode)
{
	VVersion version;
	if (ReadAttribute(io_rNode, {"VERSION", ""}, version))
		io_rNode.SetVersion(version);
	std::string text;
	ReadAttribute(io_rNode, {"NAME", "", "xsd:ID", true}, text);
	ReadAttribute(io_rNode, {"REF", "", "xsd:IDREF", false, {2, 0}, {3, 4}}, text);
	std::vector<double> list;
	std::vector<bool> placeholders;
	ReadList(io_rNode, {"LIST", ""}, 3, list);
	ReadListWithPlaceholders(io_rNode, {"T", ""}, 2, list, placeholders, 1);
	std::int32_t number = 0;
	ReadAttribute(io_rNode, {"NUMBER", ""}, number);
	bool bFlag = false;
	ReadAttribute(io_rNode, {"FLAG", ""}, bFlag);
	io_rNode.DeclareElement("Left", "", 1, 1);
	io_rNode.DeclareElement("Right", "", 1, 1, {2, 0});
	io_rNode.ProcessElements(Node, true);
	io_rNode.DeclareElement("Node", "", 0, 2);
	io_rNode.DeclareElement("Many", "", 1, c_Unbounded, {}, {3, 0});
	io_rNode.ProcessElements(Node);
}

} // namespace

extern "C" std::size_t LLVMFuzzerCustomMutator(
    std::uint8_t* io_pData, std::size_t i_Size, std::size_t i_MaximumSize, unsigned int i_Seed)
{
	return XmlTree::Mutate(io_pData, i_Size, i_MaximumSize, i_Seed);
}

/// What parses is walked, and what is printed parses again to the same text; what does not gives an error.
extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* i_pData, std::size_t i_Size)
{
	VDocument document;
	std::string error;
	if (!document.Parse(std::string(reinterpret_cast<const char*>(i_pData), i_Size), error))
	{
		Require(!error.empty());
		return 0;
	}
	std::shared_ptr<VReaderNode::VGlobalInfo> pInfo;
	{
		VReaderNode root(document, i_Size % 2 == 1);
		pInfo = root.GetGlobalInfo();
		root.DeclareElement("Node", "", 1, 1);
		root.ProcessElements(Node);
	}
	Require(pInfo->m_Errors.GetTexts().size() <= pInfo->m_Errors.GetCount() + 1);

	VDocument again;
	const std::string printed = document.Print();
	Require(again.Parse(printed, error));
	VDocument third;
	Require(third.Parse(again.Print(), error) && third.Print() == again.Print());
	return 0;
}
