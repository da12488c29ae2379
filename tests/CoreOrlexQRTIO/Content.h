#pragma once

#include "../UtilsFileSystem/Folder.h"

#include "CoreOrlexQRTIO/FormatVersions.h"
#include "CoreOrlexQRTIO/Reader.h"
#include "CoreOrlexQRTIO/Writer.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace CoreOrlexQRTIO
{

/// A subject with what was said when it was read.
struct VContent
{
	CoreOrlexTypes::VSubjectParametrised m_Subject;
	CoreOrlexTypes::VSubjectApplicationData m_ApplicationData;
	VSubjectQRTExtras m_Extras;
	std::vector<std::string> m_Errors;
	std::vector<std::string> m_Warnings;
	bool m_bRead = false;
};

inline constexpr std::uint32_t c_TestId = 0x0FFFFFFF;

inline std::string DataText(const std::string& i_rName)
{
	return Get(RETARGET_TEST_DATA "/qrt/" + i_rName);
}

inline VContent ReadText(const std::string& i_rText, std::uint32_t i_Id = c_TestId)
{
	VContent content;
	content.m_bRead = VReader().ReadText(i_rText, "Template", i_Id, content.m_Subject, content.m_ApplicationData,
	    content.m_Extras, content.m_Errors, content.m_Warnings);
	return content;
}

/// The text at a version, with no error.
inline std::string WriteText(const VContent& i_rContent, std::uint32_t i_Version = c_AutomaticVersion)
{
	std::string text;
	std::vector<std::string> errors;
	std::vector<std::string> warnings;
	EXPECT_TRUE(VWriter().WriteText(
	    i_rContent.m_Subject, i_rContent.m_ApplicationData, i_rContent.m_Extras, i_Version, text, errors, warnings));
	EXPECT_EQ(errors, std::vector<std::string>());
	return text;
}

/// What each written file has and the reader does not know.
inline const std::vector<std::string> c_WrittenFileWarnings{
    "Ignoring unrecognised attribute: //KinematicModel/xmlns:xsi",
    "Ignoring unrecognised attribute: //KinematicModel/xsi:noNamespaceSchemaLocation"};

inline void ExpectSame(const VContent& i_rA, const VContent& i_rB)
{
	EXPECT_TRUE(i_rA.m_Subject == i_rB.m_Subject);
	EXPECT_TRUE(i_rA.m_ApplicationData == i_rB.m_ApplicationData);
	EXPECT_TRUE(i_rA.m_Extras == i_rB.m_Extras);
}

} // namespace CoreOrlexQRTIO
