#include "RetargetSetupCore/LegacyText.h"

#include "../UtilsFileSystem/Folder.h"
#include "CoreOrlexTypes/TextForm.h"
#include "TestSubjects.h"

#include <gtest/gtest.h>

namespace
{

using namespace RetargetSetup;
using CoreOrlexTypes::VSubjectRecord;
using VTarget = CoreOrlexTypes::VSubjectParametrised::VTarget;

TEST(ParseLegacyText, HeadersAndRecords)
{
	const struct
	{
		const char* m_pText;
		std::uint32_t m_Status;
	} rows[] = {
	    {R"([[1,0,1],"s"] {})", 0},
	    {R"({"Version":[1,0,0],"Schema":"s"}{ "SubjectParametrised" : { "Name" : "n" } })", 0},
	    {R"({"Schema":"s"}[])", 0x80000000u},
	    {R"({} {})", 0},
	    {R"([[0,99,99],""]{})", 0},
	    {R"([[1,0,2],""]{})", 0x80000018u},
	    {R"([[1,1,0],""]{})", 0x80000018u},
	    {R"([[2,0,0],""] damaged)", 0x80000018u},
	    {R"([[1,0],""]{})", 0x80000000u},
	    {R"([[1,0,1]]{})", 0x80000000u},
	    {R"([[1,0,1],""])", 0x80000000u},
	    {R"([[1,0,1],""]{"SubjectParametrised":{"Name":1}})", 0x80000000u},
	    {"", 0x80000000u},
	    {"<?xml?>", 0x80000000u},
	};
	for (const auto& rRow : rows)
	{
		VSubjectRecord record;
		EXPECT_EQ(ParseLegacyText(rRow.m_pText, record), rRow.m_Status) << rRow.m_pText;
	}
}

VSubjectRecord Foreign()
{
	VSubjectRecord record;
	record.m_SubjectParametrised = MakeSubject({{"a", -1}, {"b", 0}});
	record.m_SubjectParametrised.m_Name = "Otto";
	record.m_SubjectParametrised.m_SubjectId = 4;
	record.m_SubjectParametrised.m_Markers.resize(1);
	record.m_SubjectParametrised.m_Targets.resize(2);
	record.m_SubjectParametrised.m_Targets[0].m_Type = VTarget::ELocalRotationToWorldRotation;
	record.m_SubjectParametrised.m_Targets[0].m_RotationCalibrationBehaviour = VTarget::EHingeLike;
	record.m_SubjectParametrised.m_Targets[1].m_RotationCalibrationBehaviour = VTarget::EHingeLike;
	record.m_SubjectApplicationData.m_SubjectId = 5;
	record.m_SubjectApplicationData.m_Segments.resize(7);
	record.m_SubjectApplicationData.m_Targets.resize(2);
	return record;
}

TEST(RepairLegacyRecord, TellsEachThingThatItBringsIntoLine)
{
	VSubjectRecord record = Foreign();
	VLogRecorder log;
	RepairLegacyRecord(record);
	EXPECT_EQ(record.m_SubjectParametrised.m_Name, "Template");
	EXPECT_EQ(record.m_SubjectParametrised.m_SubjectId, 0x0FFFFFFFu);
	EXPECT_EQ(record.m_SubjectApplicationData.m_SubjectId, 0x0FFFFFFFu);
	EXPECT_EQ(record.m_SubjectApplicationData.m_Markers.size(), 1u);
	EXPECT_EQ(record.m_SubjectApplicationData.m_Segments.size(), 2u);
	EXPECT_EQ(record.m_SubjectApplicationData.m_Targets.size(), 2u);
	EXPECT_EQ(record.m_SubjectParametrised.m_Targets[0].m_RotationCalibrationBehaviour, VTarget::EOther);
	EXPECT_EQ(record.m_SubjectParametrised.m_Targets[1].m_RotationCalibrationBehaviour, VTarget::EHingeLike);
	EXPECT_EQ(log.Take(),
	    "3 RetargetSetup: Legacy file: the subject's name 'Otto' becomes 'Template'\n"
	    "3 RetargetSetup: Legacy file: the id 4 of the subject becomes 268435455\n"
	    "3 RetargetSetup: Legacy file: the id 5 of the application data becomes 268435455\n"
	    "3 RetargetSetup: Legacy file: the application data of 0 markers is brought to the subject's 1\n"
	    "3 RetargetSetup: Legacy file: the application data of 7 segments is brought to the subject's 2");
	const VSubjectRecord repaired = record;
	RepairLegacyRecord(record);
	EXPECT_EQ(record, repaired);
	EXPECT_EQ(log.Take(), "");
}

TEST(LegacyFile, EveryTruncationIsRefusedAndTold)
{
	std::string text = "[[1,0,1],\"\"]\n";
	ASSERT_TRUE(CoreOrlexTypes::WriteText(Foreign(), text));
	for (std::size_t length = 0; length < text.size(); ++length)
	{
		VSubjectRecord record;
		EXPECT_EQ(ParseLegacyText(std::string_view(text).substr(0, length), record), 0x80000000u) << length;
	}
	const VTestFolder folder;
	const boost::filesystem::path file = folder / "a.qrx";
	const auto read = [&file](const std::string& i_rText, VSubjectRecord& o_rRecord)
	{
		Put(file, i_rText);
		return ReadLegacyFile(file, o_rRecord);
	};
	VLogRecorder log;
	VSubjectRecord record;
	EXPECT_EQ(read(text.substr(0, 200), record), 0x80000000u);
	EXPECT_EQ(log.Take(), "2 RetargetSetup: '" + file.string() + "' is not a legacy subject file, or is damaged");
	EXPECT_EQ(read("[[1,0,2],\"\"]", record), 0x80000018u);
	EXPECT_EQ(log.Take(), "2 RetargetSetup: The legacy file '" + file.string() + "' is of a later version than 1.0.1");
	EXPECT_EQ(read(text, record), 0u);
	VSubjectRecord expected = Foreign();
	RepairLegacyRecord(expected);
	EXPECT_EQ(record, expected);
}

TEST(LegacyFile, WhatCannotBeOpenedIsTold)
{
	const VTestFolder folder;
	for (const boost::filesystem::path& rPath : {folder / "missing.qrx", folder.Path()})
	{
		VLogRecorder log;
		VSubjectRecord record;
		EXPECT_EQ(ReadLegacyFile(rPath, record), 0x8000002Au);
		EXPECT_NE(log.Take().find("2 RetargetSetup: Cannot read the legacy file '" + rPath.string() + "': "),
		    std::string::npos);
	}
}

TEST(LegacyFile, ABombOfListsIsRefused)
{
	std::string text = R"([[1,0,1],""]{"SubjectParametrised":{"Segments":[{})";
	for (int i = 0; i < 2000000; ++i)
		text += ",{}";
	VSubjectRecord record;
	EXPECT_EQ(ParseLegacyText(text + "]}}", record), 0x80000000u);
}

} // namespace
