#include "NVX/Shared.h"
#include "NVX/CountedPointer.h"

#include <gtest/gtest.h>

namespace
{

class VThing : public NVX::VShared
{
public:
	explicit VThing(int i_Start) : m_Value(i_Start) {}

	void Add(int i_More) { m_Value += i_More; }
	std::function<void(int)> Adder() const { return WeakBind(&VThing::Add); }

	int m_Value;
	int m_Completions = 0;
	bool m_bWorkedAtCompletion = false;

protected:
	void OnShared() override
	{
		++m_Completions;
		Adder()(1);
		m_bWorkedAtCompletion = m_Value == 8;
	}
};

TEST(Shared, CompletesOnceWithTheWeakPointerInPlace)
{
	const auto pThing = NVX::MakeShared<VThing>(7);
	EXPECT_EQ(pThing->m_Completions, 1);
	EXPECT_TRUE(pThing->m_bWorkedAtCompletion);
	EXPECT_EQ(pThing.use_count(), 1) << "the object must not own itself";
}

TEST(Shared, AWeakCallbackOutlivesItsObjectAndSaysSo)
{
	auto pThing = NVX::MakeShared<VThing>(0);
	const auto adder = pThing->Adder();
	adder(5);
	EXPECT_EQ(pThing->m_Value, 6);
	pThing.reset();
	EXPECT_THROW(adder(5), NVX::VDeregisterWeakCallbackException);
}

class VCountedThing : public NVX::VCounted<NVX::ICounted>
{
public:
	explicit VCountedThing(int& io_rLiving) : m_rLiving(io_rLiving) { ++m_rLiving; }
	~VCountedThing() override { --m_rLiving; }

private:
	int& m_rLiving;
};

TEST(CountedPointer, TheLastOwnerEndsTheObject)
{
	int living = 0;
	NVX::CountedPointer<NVX::ICounted> pOther;
	{
		const NVX::CountedPointer<VCountedThing> pFirst(new VCountedThing(living));
		pOther = pFirst;
	}
	EXPECT_EQ(living, 1);
	pOther = nullptr;
	EXPECT_EQ(living, 0);
}

} // namespace
