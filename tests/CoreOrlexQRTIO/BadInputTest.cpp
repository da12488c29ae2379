#include "Content.h"

#include <algorithm>
#include <clocale>
#include <random>

namespace CoreOrlexQRTIO
{
namespace
{

using VTexts = std::vector<std::string>;

/// What holds for whatever was read, fine or not: lists run side by side, indices are in range, and a failure has a
/// reason.
void ExpectSound(const VContent& i_rContent)
{
	const auto& rSubject = i_rContent.m_Subject;
	const auto& rApplicationData = i_rContent.m_ApplicationData;
	EXPECT_EQ(i_rContent.m_bRead, i_rContent.m_Errors.empty());
	EXPECT_EQ(rSubject.m_Segments.size(), rApplicationData.m_Segments.size());
	EXPECT_EQ(rSubject.m_Segments.size(), i_rContent.m_Extras.m_Segments.size());
	EXPECT_EQ(rSubject.m_Markers.size(), rApplicationData.m_Markers.size());
	EXPECT_EQ(rSubject.m_Markers.size(), i_rContent.m_Extras.m_Markers.size());
	EXPECT_EQ(rSubject.m_Targets.size(), rApplicationData.m_Targets.size());
	EXPECT_EQ(rSubject.m_Targets.size(), i_rContent.m_Extras.m_Targets.size());
	for (std::uint32_t i = 0; i < rSubject.m_Segments.size(); ++i)
	{
		EXPECT_EQ(rSubject.m_Segments[i].m_SegmentIndex, i);
		const std::uint32_t parent = rSubject.m_Segments[i].m_ParentSegmentIndex;
		EXPECT_TRUE(parent == CoreOrlexTypes::c_NoParent || parent < i);
	}
	for (const auto& rTarget : rSubject.m_Targets)
	{
		const auto inRange = [](const auto& i_rIndices, std::size_t i_Size)
		{ return std::ranges::all_of(i_rIndices, [&](std::uint32_t i_Index) { return i_Index < i_Size; }); };
		EXPECT_TRUE(inRange(rTarget.m_SegmentIndices, rSubject.m_Segments.size()));
		EXPECT_TRUE(inRange(rTarget.m_MarkerIndices, rSubject.m_Markers.size()));
		EXPECT_TRUE(inRange(rTarget.m_RotationObservationIndices, rSubject.m_Rotations.size()));
	}
}

TEST(BadInput, TruncatedAtEveryByte)
{
	for (const char* const pName : {"version-1.0.qrs", "version-3.5.qrs"})
	{
		std::string text = DataText(pName);
		const std::size_t whole = text.find_last_of('>') + 1;
		for (std::size_t size = 0; size < whole; ++size)
		{
			const VContent content = ReadText(text.substr(0, size));
			ASSERT_FALSE(content.m_bRead) << size;
			ExpectSound(content);
		}
	}
}

TEST(BadInput, DamagedBytes)
{
	const std::string text = DataText("version-3.5.qrs");
	std::mt19937 random(20240229);
	const std::string bytes = "<>\"'/=&;-+.*0 9eE#x\n\t\xC3\xFF";
	int read = 0;
	for (int i = 0; i < 3000; ++i)
	{
		std::string damaged = text;
		for (auto hits = 1 + random() % 3; hits > 0; --hits)
		{
			const std::size_t place = random() % damaged.size();
			switch (random() % 3)
			{
			case 0: damaged[place] = bytes[random() % bytes.size()]; break;
			case 1: damaged.erase(place, 1 + random() % 40); break;
			default: damaged.insert(place, damaged.substr(random() % damaged.size(), random() % 40)); break;
			}
		}
		const VContent content = ReadText(damaged);
		ExpectSound(content);
		if (!content.m_bRead)
			continue;
		++read;
		std::string written;
		VTexts errors;
		VTexts warnings;
		const bool bWritten = VWriter().WriteText(
		    content.m_Subject, content.m_ApplicationData, content.m_Extras, 16, written, errors, warnings);
		EXPECT_TRUE(!bWritten || ReadText(written).m_bRead) << written;
	}
	EXPECT_GT(read, 100);
}

std::string Repeated(const std::string& i_rText, std::size_t i_Count)
{
	std::string text;
	text.reserve(i_rText.size() * i_Count);
	for (std::size_t i = 0; i < i_Count; ++i)
		text += i_rText;
	return text;
}

TEST(BadInput, NestedTooDeep)
{
	const std::string open = "<Segment NAME='s'><JointDummy/>";
	for (const std::size_t depth : {200000, 511})
	{
		const VContent content = ReadText("<KinematicModel VERSION='3.5'><Skeleton>" + Repeated(open, depth)
		    + Repeated("</Segment>", depth) + "</Skeleton></KinematicModel>");
		EXPECT_EQ(content.m_Errors, VTexts({"Failed to read file"}));
		EXPECT_EQ(content.m_Warnings, VTexts({"line 1: elements are nested deeper than 512"}));
		EXPECT_TRUE(content.m_Subject.m_Segments.empty());
	}
}

TEST(BadInput, FilesThatAreNone)
{
	const VTestFolder folder;
	for (const boost::filesystem::path& rPath : {folder.Path(), folder / "none.qrs"})
	{
		VContent content = ReadText(DataText("performer.qrs"));
		EXPECT_FALSE(VReader().Read(rPath, "Template", c_TestId, content.m_Subject, content.m_ApplicationData,
		    content.m_Extras, content.m_Errors, content.m_Warnings));
		EXPECT_EQ(content.m_Errors, VTexts({"Error opening file '" + rPath.string() + "' for reading"}));
		EXPECT_TRUE(content.m_Subject.m_Segments.empty());
	}
}

TEST(Locale, DecimalCommasChangeNothing)
{
	const std::string before = WriteText(ReadText(DataText("version-3.5.qrs")));
	if (!std::setlocale(LC_ALL, "de_DE.UTF-8"))
		GTEST_SKIP() << "the locale de_DE.UTF-8 is not installed";
	const VContent content = ReadText(DataText("version-3.5.qrs"));
	const std::string after = WriteText(content);
	std::setlocale(LC_ALL, "C");
	EXPECT_EQ(content.m_Subject.m_DynamicParameters[0].m_Value, 1.5);
	EXPECT_TRUE(after == before);
}

} // namespace
} // namespace CoreOrlexQRTIO
