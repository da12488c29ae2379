#include "Content.h"

#include <array>
#include <cstdio>

namespace CoreOrlexQRTIO
{
namespace
{

/// Runs xmllint in a folder of its own, over files that it finds there.
class Schema : public testing::Test
{
protected:
	void SetUp() override
	{
		if (Run("xmllint --version") != 0)
			GTEST_SKIP() << "xmllint is not installed";
		ASSERT_TRUE(VReader().WriteSchema(m_Folder / "schema.xsd"));
	}

	int Run(const std::string& i_rCommand)
	{
		m_Output.clear();
		std::FILE* const pPipe =
		    popen(("cd '" + m_Folder.Path().string() + "' && " + i_rCommand + " 2>&1").c_str(), "r");
		if (!pPipe)
			return -1;
		std::array<char, 4096> buffer;
		while (const std::size_t size = std::fread(buffer.data(), 1, buffer.size(), pPipe))
			m_Output.append(buffer.data(), size);
		return pclose(pPipe);
	}

	/// Lines of complaint about a text.
	std::vector<std::string> Validate(const std::string& i_rText)
	{
		Put(m_Folder / "file.xml", i_rText);
		const int status = Run("xmllint --noout --nonet --schema schema.xsd file.xml");
		std::vector<std::string> lines;
		std::istringstream stream(m_Output);
		for (std::string line; std::getline(stream, line);)
			if (line.find("error") != std::string::npos)
				lines.push_back(line);
		EXPECT_EQ(status == 0, lines.empty()) << m_Output;
		return lines;
	}

	const VTestFolder m_Folder;
	std::string m_Output;
};

TEST_F(Schema, IsASchemaAndTakesWhatIsWritten)
{
	EXPECT_EQ(Validate(Get(RETARGET_SOURCE "/demo/performer.qrs")), std::vector<std::string>());
	EXPECT_EQ(Validate(WriteText(ReadText(DataText("performer.qrs")))), std::vector<std::string>());
	EXPECT_EQ(Validate(WriteText(ReadText(DataText("version-1.0.qrs")), 0)), std::vector<std::string>());
}

/// The short list of docs/skeleton-format.md: what is written although the schema takes it for an error.
TEST_F(Schema, FlagsTheShortList)
{
	VContent content = ReadText(DataText("version-3.5.qrs"));
	const std::vector<std::string> order = Validate(WriteText(content));
	ASSERT_EQ(order.size(), 1u);
	EXPECT_NE(order[0].find("Element 'TargetLocalPlaneToWorldPoint': This element is not expected."), std::string::npos)
	    << order[0];

	content = ReadText(DataText("performer.qrs"));
	content.m_Subject.m_Markers[0].m_Name = "Hips";
	std::vector<std::string> complaints = Validate(WriteText(content));
	ASSERT_EQ(complaints.size(), 1u);
	EXPECT_NE(complaints[0].find("'Hips' is not a valid value of the atomic type 'xs:ID'"), std::string::npos)
	    << complaints[0];

	content.m_Subject.m_Markers[0].m_Name = "left hip";
	complaints = Validate(WriteText(content));
	ASSERT_FALSE(complaints.empty());
	EXPECT_NE(complaints[0].find("'left hip' is not a valid value of the atomic type 'xs:ID'"), std::string::npos)
	    << complaints[0];
}

TEST_F(Schema, KeepsDocsTypesAndVersions)
{
	const std::string text = VReader().SchemaText();
	EXPECT_TRUE(Get(m_Folder / "schema.xsd") == text);
	for (const char* const pPart :
	    {"<?xml-stylesheet type=\"text/xsl\" href=\"Orlex_QRT_Schema-HTML.xsl\"?>",
	        "<xsd:element name=\"KinematicModel\">", "The rotation to apply to the geometry tat represents the segment",
	        "temporal derivative  of the PCA coeffficient", "<xsd:simpleType name=\"TYPE_TARGET-DRAW-STYLE\">",
	        "The ROTATION offset of the target observation", "orlex:maxVersion=\"2.6\""})
		EXPECT_NE(text.find(pPart), std::string::npos) << pPart;
}

} // namespace
} // namespace CoreOrlexQRTIO
