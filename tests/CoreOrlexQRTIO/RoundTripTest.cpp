#include "Content.h"

namespace CoreOrlexQRTIO
{
namespace
{

using VTexts = std::vector<std::string>;

TEST(RoundTrip, PerformerReadsWithoutAWordAndComesBackEqual)
{
	const VContent performer = ReadText(ReadBytes(DataPath("performer.qrs")));
	ASSERT_TRUE(performer.m_bRead);
	EXPECT_EQ(performer.m_Errors, VTexts());
	EXPECT_EQ(performer.m_Warnings, VTexts());
	EXPECT_EQ(performer.m_Subject.m_Segments.size(), 31u);
	EXPECT_EQ(performer.m_Subject.m_Targets.size(), 44u);

	const std::string first = WriteText(performer);
	const VContent again = ReadText(first);
	EXPECT_TRUE(again.m_bRead);
	EXPECT_EQ(again.m_Warnings, c_WrittenFileWarnings);
	ExpectSame(performer, again);
	EXPECT_TRUE(WriteText(again) == first);
}

} // namespace
} // namespace CoreOrlexQRTIO
