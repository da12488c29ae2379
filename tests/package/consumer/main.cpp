#include "FBXIO/FBXReader.h"
#include "RetargetSetupCore/TargetConstruction.h"

#include <cstdio>

/// Makes a subject of the skeleton in an FBX file.
int main(int i_Count, char** i_ppArguments)
{
	FBXIO::FBXReader reader;
	if (i_Count != 2 || !reader.LoadFile(i_ppArguments[1]) || !reader.HasSkeleton())
		return 1;
	CoreOrlexTypes::VSubjectParametrised subject;
	CoreOrlexTypes::VSubjectApplicationData data;
	RetargetSetup::BuildTargetSubject(*reader.GetSkeleton(), subject, data, 0);
	std::printf("%zu segments, the first is %s\n", subject.m_Segments.size(), subject.m_Segments.at(0).m_Name.c_str());
	return subject.m_Segments.size() == reader.GetSkeleton()->size() ? 0 : 1;
}
