#pragma once

#include "../LogRecorder.h"
#include "../Matrices.h"
#include "CoreOrlexTypes/JointType.h"
#include "CoreOrlexTypes/SubjectParametrised.h"
#include "FBXIO/SkinSkeleton.h"
#include "RetargetSetupCore/GlobalScale.h"
#include "RetargetSetupCore/Identity.h"
#include "RetargetSetupCore/Joints.h"

#include <initializer_list>
#include <string>

struct VTestSegment
{
	const char* m_pName;
	int m_Parent;
	std::array<const char*, 3> m_PreTranslation{"0", "0", "0"};
};

/// Free root, Ball joints below, all at rest; with the document's identity and a scale of 1.
inline CoreOrlexTypes::VSubjectParametrised MakeSubject(std::initializer_list<VTestSegment> i_Segments)
{
	CoreOrlexTypes::VSubjectParametrised subject;
	subject.m_Name = RetargetSetup::c_SubjectName;
	subject.m_SubjectId = RetargetSetup::c_SubjectId;
	RetargetSetup::SetGlobalScale(subject, 1.0);
	for (const VTestSegment& rTest : i_Segments)
	{
		auto& rSegment = subject.m_Segments.emplace_back();
		rSegment.m_Name = rTest.m_pName;
		rSegment.m_SegmentIndex = std::uint32_t(subject.m_Segments.size() - 1);
		if (rTest.m_Parent >= 0)
		{
			rSegment.m_ParentSegmentIndex = std::uint32_t(rTest.m_Parent);
			rSegment.m_TreeDepth = subject.m_Segments[std::size_t(rTest.m_Parent)].m_TreeDepth + 1;
		}
		for (std::size_t i = 0; i < 3; ++i)
			rSegment.m_PreTranslation[i] = rTest.m_PreTranslation[i];
		RetargetSetup::EnableJoint(subject, subject.m_Segments.size() - 1, {});
	}
	return subject;
}

inline FBXIO::VSkinBone MakeBone(
    const char* i_pName, std::int64_t i_Parent, float i_X = 0, float i_Y = 0, float i_Z = 0)
{
	FBXIO::VSkinBone bone;
	bone.m_Name = i_pName;
	bone.m_ParentIndex = i_Parent;
	Move(bone.m_Local, i_X, i_Y, i_Z);
	return bone;
}
