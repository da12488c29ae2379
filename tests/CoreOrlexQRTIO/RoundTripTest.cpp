#include "Content.h"

#include "CoreOrlexQRTIO/FileDifference.h"

namespace CoreOrlexQRTIO
{
namespace
{

using VTexts = std::vector<std::string>;

TEST(RoundTrip, PerformerReadsWithoutAWordAndComesBackEqual)
{
	const VContent performer = ReadText(DataText("performer.qrs"));
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

/// What a file does not tell makes no difference; what it tells does, through any order of the observations.
TEST(FileDifference, LeavesOutWhatAFileDoesNotTell)
{
	CoreOrlexTypes::VSubjectRecord written;
	CoreOrlexTypes::VSubjectParametrised& rSubject = written.m_SubjectParametrised;
	rSubject.m_Segments.resize(1);
	rSubject.m_Markers.resize(1);
	rSubject.m_Rotations = {{"Hips", 7}, {"Arm", 8}};
	rSubject.m_Targets.resize(2);
	rSubject.m_Targets[0].m_RotationObservationIndices = {0};
	rSubject.m_Targets[1].m_RotationObservationIndices = {1};
	CoreOrlexTypes::VSubjectRecord read = written;
	read.m_SubjectParametrised.m_Segments[0].m_Joint.m_JointOrientation[2] = 1e-15;
	read.m_SubjectParametrised.m_Markers[0].m_MarkerId = 12;
	read.m_SubjectParametrised.m_Rotations = {{"Arm", 0}, {"Hips", 1}};
	EXPECT_EQ(FileDifference(written, read), "SubjectParametrised.Targets[0].RotationObservationIndices[0]");
	std::swap(read.m_SubjectParametrised.m_Targets[0], read.m_SubjectParametrised.m_Targets[1]);
	EXPECT_EQ(FileDifference(written, read), "");
	read.m_SubjectParametrised.m_Segments[0].m_Joint.m_JointOrientation[2] = 1e-9;
	EXPECT_EQ(FileDifference(written, read), "SubjectParametrised.Segments[0].Joint.JointOrientation[2]");
}

} // namespace
} // namespace CoreOrlexQRTIO
