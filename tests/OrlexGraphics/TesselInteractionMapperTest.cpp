#include "OrlexGraphics/TesselInteractionMapper.h"
#include "InMemoryHost/Dispatcher.h"
#include "TesselPluginInterface/IPreferenceFolders.h"

#include <gtest/gtest.h>

namespace
{

class VPreferences : public TesselPluginInterface::IPreferenceFolders
{
public:
	boost::filesystem::path Folder(const std::string& /*i_rKey*/) const override { return {}; }
	std::int32_t Number(const std::string& i_rKey, std::int32_t i_Default) const override
	{
		return i_rKey == TesselPluginInterface::c_NavigationAltKey && m_bSet ? m_Value : i_Default;
	}
	NVX::VSignal<std::string>& ChangedSignal() override { return m_ChangedSignal; }

	bool m_bSet = false;
	std::int32_t m_Value = 0;
	NVX::VSignal<std::string> m_ChangedSignal;
};

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
	const auto pPreferences = std::make_shared<VPreferences>();
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

	pPreferences->m_bSet = true;
	pPreferences->ChangedSignal().Fire("FolderSkins");
	pDispatcher->RunPending();
	check(true);
	pPreferences->ChangedSignal().Fire(TesselPluginInterface::c_NavigationAltKey);
	pDispatcher->RunPending();
	check(false);
}

} // namespace
