#include "../UtilsFileSystem/Log.h"
#include "SmallFiles.h"
#include "SoundScene.h"

#include <gtest/gtest.h>

#include <cstdlib>

using namespace FBXIO;
using namespace FbxTest;

namespace
{

/// What comes of the bytes must be whole.
/// @return whether all of them could be read.
bool ExpectSound(const std::string& i_rBytes)
{
	FBXReader reader;
	if (!reader.LoadMemory(i_rBytes, "memory.fbx"))
	{
		EXPECT_FALSE(reader.HasSkeleton());
		return false;
	}
	EXPECT_EQ(WhatIsUnsound(reader), "");
	return reader.IsComplete();
}

/// RETARGET_MUTATIONS is by how many times more mutations are made than in a usual run; with 99 they are 100,000 of
/// bytes and 20,000 of records.
const char* const c_pTimes = std::getenv("RETARGET_MUTATIONS");

std::size_t Times(std::size_t i_Count)
{
	return i_Count * (c_pTimes ? std::strtoul(c_pTimes, nullptr, 10) : 1);
}

/// Every byte; under the sanitizers, which take twenty times as long, only if more mutations are asked for too.
#ifdef RETARGET_SANITIZED
const std::size_t c_Step = c_pTimes ? 1 : 11;
#else
const std::size_t c_Step = 1;
#endif

/// Nothing is told, and the stack is small.
class DamagedFile : public testing::TestWithParam<VSmallFile>
{
protected:
	/// @return how many of what i_rMutate makes could be read in full.
	static std::size_t ExpectSoundOfSeeds(
	    std::size_t i_Count, const std::function<std::string(std::mt19937&)>& i_rMutate)
	{
		std::size_t complete = 0;
		OnSmallStack(
		    [&]
		    {
			    for (std::size_t seed = 0; seed < i_Count && !HasFailure(); ++seed)
			    {
				    SCOPED_TRACE(seed);
				    std::mt19937 random{std::mt19937::result_type(seed)};
				    complete += ExpectSound(i_rMutate(random));
			    }
		    });
		return complete;
	}

	const std::vector<VTestRecord> m_Records = SmallRecords(GetParam());
	const std::string m_Bytes = Write(GetParam().m_Form, m_Records);
	const VTestLog m_Quiet{"FBXIO"};
};

TEST_P(DamagedFile, CutAnywhereIsIncomplete)
{
	OnSmallStack(
	    [this]
	    {
		    EXPECT_TRUE(ExpectSound(m_Bytes));
		    // Behind this stands nothing that is read: the footer, or a last end of line.
		    const std::size_t end = m_Bytes.size() - (GetParam().m_Form.m_Form == EForm::Binary ? 40 : 1);
		    for (std::size_t size = 0; size <= m_Bytes.size() && !HasFailure(); size += c_Step)
			    EXPECT_EQ(ExpectSound(m_Bytes.substr(0, size)), size >= end) << size;
	    });
}

TEST_P(DamagedFile, FourPatchesOfEveryByte)
{
	OnSmallStack(
	    [this]
	    {
		    for (std::size_t at = 0; at < m_Bytes.size() && !HasFailure(); at += c_Step)
			    for (const char patch : {'\0', '\xff', char(m_Bytes[at] ^ 1), char(m_Bytes[at] ^ 0x80)})
			    {
				    SCOPED_TRACE(at);
				    std::string patched = m_Bytes;
				    patched[at] = patch;
				    ExpectSound(patched);
			    }
	    });
}

TEST_P(DamagedFile, MutatedBytes)
{
	const std::size_t count = Times(170);
	const std::size_t complete =
	    ExpectSoundOfSeeds(count, [this](std::mt19937& io_rRandom) { return MutateBytes(m_Bytes, io_rRandom); });
	EXPECT_GT(complete, 0u);
	EXPECT_LT(complete, count / 2);
}

TEST_P(DamagedFile, MutatedRecords)
{
	const std::size_t count = Times(34);
	const std::size_t complete = ExpectSoundOfSeeds(count,
	    [this](std::mt19937& io_rRandom)
	    {
		    // Some in the form of another version than that of their records.
		    const VTestForm& rForm = io_rRandom() % 8 == 0 ? c_Forms[io_rRandom() % 5] : GetParam().m_Form;
		    return Write(rForm, MutateRecords(m_Records, io_rRandom));
	    });
	EXPECT_GT(complete, count / 5);
	EXPECT_LT(complete, count);
}

INSTANTIATE_TEST_SUITE_P(Small, DamagedFile, testing::ValuesIn(c_SmallFiles),
    [](const auto& i_rInfo) { return std::string(i_rInfo.param.m_pName); });

} // namespace
