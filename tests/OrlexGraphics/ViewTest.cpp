#include "ViewFixture.h"

#include <QQmlPropertyMap>

namespace
{

TEST_F(VViewTest, DrawsTheBackgroundColour)
{
	Show(std::make_shared<OrlexGraphics::VOrlexScene>(m_pShaders, m_pSelection, nullptr, m_pDispatcher, false));
	EXPECT_TRUE(Until([&] { return m_pWidget->grabFramebuffer().pixel(100, 80) == 0xff202020; }));

	// As QML writes it.
	m_pView->GetSceneOptions()->insert("BackgroundColorRGB", 0x4080c0);
	m_pView->OnSceneOptionsMapChanged("BackgroundColorRGB", 0x4080c0);
	EXPECT_TRUE(Until([&] { return m_pWidget->grabFramebuffer().pixel(100, 80) == 0xff4080c0; }));
}

} // namespace
