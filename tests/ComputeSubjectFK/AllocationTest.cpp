#include "../Allocations.h"
#include "ReferenceFK.h"

#include "ComputeSubjectFK/ComputeSubjectFK.h"

#include <gtest/gtest.h>

TEST(Update, AllocatesNothing)
{
	using VTarget = Reference::VSubject::VTarget;
	std::mt19937 random(7);
	Reference::VSubject subject = Reference::RandomSubject(random, 40);
	for (const auto type : {VTarget::ELocalPointToWorldPoint, VTarget::ELocalLineToWorldPoint,
	         VTarget::ELocalPlaneToWorldPoint, VTarget::ERigidBody, VTarget::ELocalRotationToWorldRotation})
		subject.m_Targets.push_back(
		    Reference::Target(type, 3, std::vector<double>(type == VTarget::ELocalPointToWorldPoint ? 3 : 6, 1.0), 0));
	subject.m_Targets[3].m_MarkerIndices = {1, 2};
	subject.m_Targets[3].m_State.resize(12, 2.0);
	subject.m_Targets[4].m_State.resize(3);
	const std::vector<double> state = Reference::RandomState(random, subject, 1.0);
	ComputeSubject::VComputeSubjectFK fk(subject);

	const std::size_t before = AllocationCount();
	for (int i = 0; i < 10; ++i)
		fk.Update(state.data());
	EXPECT_EQ(AllocationCount(), before);
	// The counter itself works.
	ComputeSubject::VComputeSubjectFK copy(fk);
	EXPECT_GT(AllocationCount(), before);
}
