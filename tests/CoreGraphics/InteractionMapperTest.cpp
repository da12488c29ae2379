#include "CoreGraphics/InteractionMapper.h"

#include <gtest/gtest.h>

#include <optional>

using namespace CoreGraphics;

TEST(InteractionMapper, OneActionForButtonsAndKeys)
{
	struct VRow
	{
		std::uint32_t m_Buttons;
		std::uint32_t m_Modifiers;
		std::optional<EInteraction> m_Action;
	};
	const VRow rows[] = {{EButtonLeft, 0, EInteractionOrbit}, {EButtonRight, 0, EInteractionDolly},
	    {EButtonLeft | EButtonRight, 0, EInteractionPan}, {EButtonLeft | EButtonMiddle, 0, EInteractionPan},
	    {EButtonLeft | EButtonRight | EButtonMiddle, 0, EInteractionPan}, {EButtonMiddle, 0, {}},
	    {EButtonRight | EButtonMiddle, 0, {}}, {0, 0, {}}, {EButtonLeft, EKeyAlt, EInteractionSelect},
	    {EButtonRight, EKeyAlt, EInteractionSelect}, {EButtonMiddle, EKeyAlt, EInteractionSelect}, {0, EKeyAlt, {}},
	    {EButtonLeft, EKeyAlt | EKeyShift, {}}, {EButtonLeft, EKeyShift, {}}, {EButtonRight, EKeyControl, {}}};
	const VInteractionMapper mapper;
	for (const VRow& rRow : rows)
	{
		for (const EInteraction action : {EInteractionPan, EInteractionOrbit, EInteractionDolly, EInteractionSelect})
			EXPECT_EQ(mapper.IsAction(action, rRow.m_Buttons, rRow.m_Modifiers), rRow.m_Action == action)
			    << action << " for buttons " << rRow.m_Buttons << " and keys " << std::hex << rRow.m_Modifiers;
	}
}

TEST(InteractionMapper, TheActiveOneIsAskedWhileItLives)
{
	class VAlways : public VInteractionMapper
	{
	public:
		bool IsAction(EInteraction, std::uint32_t, std::uint32_t) const override { return true; }
	};
	EXPECT_FALSE(VInteractionMapper::Test(EInteractionOrbit, EButtonLeft, 0));
	auto pMapper = std::make_shared<VInteractionMapper>();
	VInteractionMapper::SetActive(pMapper);
	EXPECT_TRUE(VInteractionMapper::Test(EInteractionOrbit, EButtonLeft, 0));
	EXPECT_FALSE(VInteractionMapper::Test(EInteractionPan, EButtonLeft, 0));
	const auto pAlways = std::make_shared<VAlways>();
	VInteractionMapper::SetActive(pAlways);
	EXPECT_TRUE(VInteractionMapper::Test(EInteractionPan, EButtonLeft, 0));
	VInteractionMapper::SetActive(pMapper);
	pMapper.reset();
	EXPECT_FALSE(VInteractionMapper::Test(EInteractionOrbit, EButtonLeft, 0));
}
