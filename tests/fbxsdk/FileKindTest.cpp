#include "fbxsdk/container/FileKind.h"

#include "FbxFileBuilder.h"
#include "fbxsdk/sdk/Manager.h"

#include <gtest/gtest.h>

using namespace FbxFormat;
using namespace std::string_literals;

namespace
{

const std::string c_Magic("Kaydara FBX Binary  \0\x1a", 22);

struct VRow
{
	const char* m_pName;
	std::string m_Head;
	EFileKind m_Kind;
	std::uint32_t m_Version = 0;
};

void PrintTo(const VRow& i_rRow, std::ostream* o_pStream)
{
	*o_pStream << i_rRow.m_pName;
}

class FileKind : public testing::TestWithParam<VRow>
{
};

TEST_P(FileKind, IsToldByTheFirstBytes)
{
	const VFileKind kind = DetectFileKind(GetParam().m_Head);
	EXPECT_EQ(kind.m_Kind, GetParam().m_Kind);
	EXPECT_EQ(kind.m_Version, GetParam().m_Version);
}

INSTANTIATE_TEST_SUITE_P(Rows, FileKind,
    testing::Values(VRow{"Empty", "", EFileKind::None},
        VRow{"Binary", c_Magic + "\0"s + FbxTest::Bytes(7400u), EFileKind::Binary, 7400},
        VRow{"BigEndian", c_Magic + "\1\0\0\x1c\xe8"s, EFileKind::BinaryBigEndian, 7400},
        VRow{"OldBinary", c_Magic + "\0"s + FbxTest::Bytes(3000u, "FBXVersionI", 5800u), EFileKind::Binary, 5800},
        VRow{"OldBinaryWithoutRecord", c_Magic + "\0"s + FbxTest::Bytes(3000u, "FBXVersionI"), EFileKind::Binary, 3000},
        VRow{"NewBinaryWithRecord", c_Magic + "\0"s + FbxTest::Bytes(6100u, "FBXVersionI", 5800u), EFileKind::Binary,
            6100},
        VRow{"MagicAlone", c_Magic, EFileKind::DamagedBinary},
        VRow{"SentAsText", "Kaydara FBX Binary  \x20\x1a\x20\x84\x1c\x20\x20", EFileKind::DamagedBinary},
        VRow{
            "Text", "; FBX 7.4.0 project file\nFBXHeaderExtension:  {\n\tFBXVersion: 7500\n}\n", EFileKind::Text, 7500},
        VRow{"TextWithoutRecord", "; FBX 5.8.0 project file\n", EFileKind::Text, 5800},
        VRow{"TextWithoutComment", "\n\n; made by hand\nFBXHeaderExtension: { FBXVersion: 6100 }", EFileKind::Text,
            6100},
        VRow{"TextWithoutVersion", "FBXHeaderExtension: { }", EFileKind::Text, 0},
        VRow{"TextWithMark", "\xEF\xBB\xBF; FBX 7.7.0 project file", EFileKind::Text, 7700},
        VRow{"HugeVersion", "; FBX 7.4.0\nFBXHeaderExtension: { FBXVersion: 99999999999 }", EFileKind::Text, 7400},
        VRow{"ProseAboutFbx", "; FBX files are nice\nFBXVersion: 7400", EFileKind::None},
        VRow{"Xml", "<?xml version=\"1.0\"?>", EFileKind::None},
        VRow{"Zeros", std::string(100, '\0'), EFileKind::None}),
    [](const auto& i_rInfo) { return i_rInfo.param.m_pName; });

TEST(FileFormat, IsOfFilesThatAreOne)
{
	fbxsdk::FbxManager* const pManager = fbxsdk::FbxManager::Create();
	const auto* const pRegistry = pManager->GetIOPluginRegistry();
	int format = -1;
	EXPECT_TRUE(pRegistry->DetectReaderFileFormat(RETARGET_SOURCE "/demo/character.fbx", format));
	EXPECT_GE(format, 0);
	for (const char* const pOther : {"/demo/performer.qrs", "/demo/none.fbx", "/demo"})
		EXPECT_FALSE(pRegistry->DetectReaderFileFormat((std::string(RETARGET_SOURCE) + pOther).c_str(), format))
		    << pOther;
	pManager->Destroy();
}

} // namespace
