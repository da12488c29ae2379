#include "OrlexGraphics/item/TesselInteractionMapper.h"
#include "InMemoryHost/Dispatcher.h"
#include "InMemoryHost/PreferenceFolders.h"

#include <gtest/gtest.h>

namespace
{

constexpr std::uint32_t c_Left = 1, c_Right = 2, c_Middle = 4, c_Alt = 0x8000000, c_Shift = 0x2000000;

/// Actions as one digit each: pan, orbit, dolly, select.
std::string Actions(
    const OrlexGraphics::VTesselInteractionMapper& i_rMapper, std::uint32_t i_Buttons, std::uint32_t i_Alt)
{
	std::string actions;
	for (const auto action : {CoreGraphics::EInteractionPan, CoreGraphics::EInteractionOrbit,
	         CoreGraphics::EInteractionDolly, CoreGraphics::EInteractionSelect})
		actions += i_rMapper.IsAction(action, i_Buttons, i_Alt) ? '1' : '0';
	return actions;
}

TEST(TesselInteractionMapper, MapsButtonsByTheAltPreference)
{
	const auto pDispatcher = std::make_shared<InMemoryHost::VDispatcher>();
	const auto pPreferences = std::make_shared<InMemoryHost::VPreferenceFolders>();
	const auto pMapper = NVX::MakeShared<OrlexGraphics::VTesselInteractionMapper>(pPreferences, pDispatcher);
	const struct
	{
		std::uint32_t m_Buttons;
		const char* m_pNavigating;
		const char* m_pSelecting;
	} rows[] = {
	    {0, "0000", "0000"},
	    {c_Left, "0100", "0001"},
	    {c_Right, "0010", "0000"},
	    {c_Middle, "0000", "0000"},
	    {c_Left | c_Right, "1000", "0001"},
	    {c_Left | c_Middle, "1000", "0001"},
	    {c_Right | c_Middle, "0000", "0000"},
	    {c_Left | c_Right | c_Middle, "1000", "0001"},
	};
	const auto check = [&](bool i_bAltSelects)
	{
		for (const auto& rRow : rows)
			for (const std::uint32_t other : {0u, c_Shift})
			{
				EXPECT_EQ(
				    Actions(*pMapper, rRow.m_Buttons, other), i_bAltSelects ? rRow.m_pNavigating : rRow.m_pSelecting)
				    << rRow.m_Buttons;
				EXPECT_EQ(Actions(*pMapper, rRow.m_Buttons, other | c_Alt),
				    i_bAltSelects ? rRow.m_pSelecting : rRow.m_pNavigating)
				    << rRow.m_Buttons << " with Alt";
			}
	};
	check(true);

	pPreferences->SetNumber("Another", 0);
	pDispatcher->RunPending();
	check(true);
	pPreferences->SetNumber(TesselPluginInterface::c_NavigationAltKey, 0);
	check(true);
	pDispatcher->RunPending();
	check(false);
}

} // namespace
