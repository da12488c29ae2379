#include "UtilsRapidXml/SchemaNode.h"
#include "UtilsRapidXml/Attributes.h"

#include <gtest/gtest.h>

namespace
{

using namespace UtilsRapidXml;

const IEnum& Styles()
{
	static const VEnum<int> s_Styles = VEnum<int>("TYPE_STYLE").Add(0, "box").Add(1, "a & b");
	return s_Styles;
}

/// A small format with all that a schema can tell: a choice, counts, versions, a type, recursion.
void Node(INode& io_rNode)
{
	std::string_view text;
	EXPECT_FALSE(io_rNode.ProcessAttribute("NAME", text, "The \"name\"", "xsd:ID", true));
	io_rNode.DeclareElement("Ball", "Ball joint", 1, 1);
	io_rNode.DeclareElement("Hinge", "Hinge joint", 1, 1, {2, 0});
	io_rNode.ProcessElements([](INode&) {}, true);
	io_rNode.DeclareEnum(Styles());
	io_rNode.ProcessAttribute("STYLE", text, "Style", "TYPE_STYLE", false, {3, 0}, {3, 1});
	io_rNode.DeclareElement("Node", "Again, with another text", 0, c_Unbounded);
	io_rNode.DeclareElement("Pair", "Two", 2, 2);
	io_rNode.ProcessElements([](INode& io_rChild) { EXPECT_EQ(io_rChild.GetName(), "Pair"); });
	io_rNode.DeclareEnum(Styles());
	EXPECT_EQ(text, "");
}

const char* const c_pSchema = R"(<?xml version="1.0" encoding="UTF-8" standalone="no"?>
<?xml-stylesheet type="text/xsl" href="style.xsl"?>
<xsd:schema xmlns:orlex="urn:versions" xmlns:xml="http://www.w3.org/XML/1998/namespace" xmlns:xsd="http://www.w3.org/2001/XMLSchema">
	<xsd:element name="Node">
		<xsd:annotation>
			<xsd:documentation xml:lang="en">A node</xsd:documentation>
		</xsd:annotation>
		<xsd:complexType>
			<xsd:sequence>
				<xsd:choice>
					<xsd:element ref="Ball"/>
					<xsd:element ref="Hinge"/>
				</xsd:choice>
				<xsd:element maxOccurs="unbounded" minOccurs="0" ref="Node"/>
				<xsd:element maxOccurs="2" minOccurs="2" ref="Pair"/>
			</xsd:sequence>
			<xsd:attribute name="NAME" type="xsd:ID" use="required">
				<xsd:annotation>
					<xsd:documentation xml:lang="en">The &quot;name&quot;</xsd:documentation>
				</xsd:annotation>
			</xsd:attribute>
			<xsd:attribute name="STYLE" type="TYPE_STYLE">
				<xsd:annotation orlex:maxVersion="3.1" orlex:minVersion="3.0">
					<xsd:documentation xml:lang="en">Style</xsd:documentation>
				</xsd:annotation>
			</xsd:attribute>
		</xsd:complexType>
	</xsd:element>
	<xsd:element name="Ball">
		<xsd:annotation>
			<xsd:documentation xml:lang="en">Ball joint</xsd:documentation>
		</xsd:annotation>
		<xsd:complexType/>
	</xsd:element>
	<xsd:element name="Hinge">
		<xsd:annotation orlex:minVersion="2.0">
			<xsd:documentation xml:lang="en">Hinge joint</xsd:documentation>
		</xsd:annotation>
		<xsd:complexType/>
	</xsd:element>
	<xsd:simpleType name="TYPE_STYLE">
		<xsd:restriction base="xsd:string">
			<xsd:enumeration value="a &amp; b"/>
			<xsd:enumeration value="box"/>
		</xsd:restriction>
	</xsd:simpleType>
	<xsd:element name="Pair">
		<xsd:annotation>
			<xsd:documentation xml:lang="en">Two</xsd:documentation>
		</xsd:annotation>
		<xsd:complexType/>
	</xsd:element>
</xsd:schema>

)";

TEST(SchemaNode, DescribesTheFormat)
{
	VDocument document;
	{
		VSchemaNode root(document, true, "urn:versions", "style.xsl");
		root.DeclareElement("Node", "A node", 0, c_Unbounded);
		root.ProcessElements(Node);
	}
	EXPECT_EQ(document.Print(), c_pSchema);
}

TEST(SchemaNode, HasNoStylesheetWithoutOne)
{
	VDocument document;
	VSchemaNode(document, false, "urn:versions", "style.xsl");
	EXPECT_EQ(document.Print().find("xml-stylesheet"), std::string::npos);
}

} // namespace
