#include "CoreOrlexTypes/NameHash.h"
#include "CoreOrlexTypes/JointType.h"

#include <gtest/gtest.h>

namespace
{

using namespace CoreOrlexTypes;

/// Published test values of the hash for texts of every length modulo 4.
TEST(NameHash, IsMurmurHash3OfTheBytes)
{
	EXPECT_EQ(HashName("hello"), 0x248BFA47u);
	EXPECT_EQ(HashName("test"), 0xBA6BD213u);
	EXPECT_EQ(HashName("abc"), 0xB3DD93FAu);
	EXPECT_EQ(HashName("hello, world"), 0x149BBB7Fu);
	EXPECT_EQ(HashName("The quick brown fox jumps over the lazy dog"), 0x2E4FF723u);
	EXPECT_EQ(HashName("H\xC3\xBC"
	                   "fte"),
	    0xB94FAF3Du);
}

TEST(NameHash, KeepsTheHighestValueForTheEmptyName)
{
	EXPECT_EQ(HashName(""), 0xFFFFFFFFu);
	EXPECT_EQ(HashName("s868WJ0Z"), 0xFFFFFFFEu); // hashes to 0xFFFFFFFF
}

TEST(JointType, DefaultCovariances)
{
	using VJoint = VSubjectParametrised::VJoint;
	const auto diagonal = [](VJoint::EJointType i_Type)
	{
		const std::vector<double> covariance = DefaultCovariance(i_Type);
		EXPECT_EQ(covariance.size(), CovarianceSize(i_Type));
		std::vector<double> values;
		for (std::size_t i = 0; i < covariance.size(); ++i)
			if (i % (StateSize(i_Type) + 1) == 0)
				values.push_back(covariance[i]);
			else
				EXPECT_EQ(covariance[i], 0.0);
		return values;
	};
	EXPECT_EQ(diagonal(VJoint::EFree), (std::vector<double>{10, 10, 10, 1e8, 1e8, 1e8}));
	EXPECT_EQ(diagonal(VJoint::EBall), (std::vector<double>{10, 10, 10}));
	EXPECT_EQ(diagonal(VJoint::EHardySpicer), (std::vector<double>{10, 10}));
	EXPECT_EQ(diagonal(VJoint::EHinge), std::vector<double>{10});
	EXPECT_EQ(diagonal(VJoint::ESlider), std::vector<double>{1e8});
	EXPECT_TRUE(diagonal(VJoint::EDummy).empty());
	EXPECT_TRUE(diagonal(VJoint::EBadJointType).empty());
	EXPECT_TRUE(diagonal(VJoint::EJointType(77)).empty());
}

} // namespace
