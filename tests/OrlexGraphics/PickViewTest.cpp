#include "InMemoryHost/PreferenceFolders.h"
#include "OrlexGraphics/item/TesselInteractionMapper.h"
#include "ViewFixture.h"

#include <QSignalSpy>

#include <numeric>

namespace
{

using VIndices = std::vector<std::uint32_t>;

TEST_F(VViewTest, SelectsWithTheMouse)
{
	m_pScene->m_Next.m_Boxes = {{Item(1), {20, 20, 40, 40}}, {Item(2), {100, 20, 40, 40}}};
	m_pSelection->Selection().Replace({Item(9)});
	Show();
	const QPoint one(40, 40), two(120, 40), nothing(80, 120);
	const struct
	{
		const char* m_pName;
		QPoint m_Where;
		Qt::KeyboardModifiers m_Modifiers;
		VIndices m_Expected;
	} rows[] = {
	    {"a click replaces all", one, {}, {1}},
	    {"Shift adds", two, Qt::ShiftModifier, {1, 2}},
	    {"what is there already stays", one, Qt::ShiftModifier, {1, 2}},
	    {"Ctrl takes out", one, Qt::ControlModifier, {2}},
	    {"Ctrl adds", one, Qt::ControlModifier, {2, 1}},
	    {"Ctrl and Shift take out", two, Qt::ControlModifier | Qt::ShiftModifier, {1}},
	    {"what is not there stays out", two, Qt::ControlModifier | Qt::ShiftModifier, {1}},
	    {"Shift on nothing", nothing, Qt::ShiftModifier, {1}},
	    {"a click on nothing clears", nothing, {}, {}},
	};
	for (const auto& rRow : rows)
	{
		Click(rRow.m_Where, rRow.m_Modifiers);
		ASSERT_TRUE(Commit()) << rRow.m_pName;
		EXPECT_EQ(Selected(), rRow.m_Expected) << rRow.m_pName;
		EXPECT_TRUE(Preselected().empty()) << rRow.m_pName;
		EXPECT_TRUE(m_pView->GetToolTipText().isEmpty()) << rRow.m_pName;
	}
}

TEST_F(VViewTest, PicksTheNearestWithinFivePixels)
{
	// One pixel each, to both sides of the mouse in (50, 50).
	m_pScene->m_Next.m_Boxes = {
	    {Item(1), {46, 50, 1, 1}},
	    {Item(2), {54, 50, 1, 1}},
	    {Item(3), {100, 53, 1, 1}},
	    {Item(4), {100, 47, 1, 1}},
	    {Item(5), {153, 50, 1, 1}},
	    {Item(6), {146, 50, 1, 1}},
	    {Item(7), {50, 106, 1, 1}},
	};
	Show();
	const struct
	{
		const char* m_pName;
		QPoint m_Where;
		VIndices m_Expected;
	} rows[] = {
	    {"left and right are equally far", {50, 50}, {1}},
	    // Rows count from the bottom.
	    {"above and below are equally far", {100, 50}, {3}},
	    {"the right one is nearer", {150, 50}, {5}},
	    {"six pixels are too far", {50, 100}, {}},
	};
	for (const auto& rRow : rows)
	{
		Click(rRow.m_Where);
		ASSERT_TRUE(Commit()) << rRow.m_pName;
		EXPECT_EQ(Selected(), rRow.m_Expected) << rRow.m_pName;
	}
}

TEST_F(VViewTest, SelectsARectangleThroughSixteenLayers)
{
	for (std::uint32_t i = 0; i < 18; ++i)
		m_pScene->m_Next.m_Boxes.push_back({Item(i), {40, 40, 40, 40}, -10.0f * static_cast<float>(i)});
	m_pScene->m_Next.m_Boxes.push_back({Item(90), {140, 40, 20, 20}});
	m_pScene->m_Next.m_Boxes.push_back({Item(91, 28), {50, 50, 10, 10}, 500.0f});
	m_pScene->m_Next.m_Boxes.push_back({Item(92, 34), {65, 65, 10, 10}, 500.0f});
	Show();

	Press({30, 30}, Qt::AltModifier);
	Drag({60, 70}, Qt::AltModifier);
	// A rectangle of the selection's colours while it is drawn.
	EXPECT_TRUE(Until([&] { return qBlue(Pixel(35, 65)) > qRed(Pixel(35, 65)) + 20; }));
	Drag({110, 110}, Qt::AltModifier);
	Release({110, 110}, Qt::AltModifier);
	ASSERT_TRUE(Commit());
	// The handles are in front of all and take a place in the first layer.
	VIndices expected(16);
	std::iota(expected.begin(), expected.end(), 0u);
	EXPECT_EQ(Selected(), expected) << "no handles, nothing behind the layers, nothing beside the rectangle";

	// The other way round, over the lower right corner and with Shift at the release alone.
	Press({165, 65}, Qt::AltModifier);
	Drag({150, 50}, Qt::AltModifier);
	Release({150, 50}, Qt::AltModifier | Qt::ShiftModifier);
	// The mouse may be gone before the next frame tells what stands in the rectangle.
	Leave();
	ASSERT_TRUE(Commit());
	expected.push_back(90);
	EXPECT_EQ(Selected(), expected);

	// Below three pixels it is a click.
	Press({150, 50}, Qt::AltModifier);
	Drag({152, 51}, Qt::AltModifier);
	Release({152, 51}, Qt::AltModifier);
	ASSERT_TRUE(Commit());
	EXPECT_EQ(Selected(), VIndices{90});

	m_pScene->m_bExactPick = true;
	Press({30, 30}, Qt::AltModifier);
	Release({110, 110}, Qt::AltModifier);
	ASSERT_TRUE(Commit());
	EXPECT_EQ(Selected(), VIndices{0}) << "one layer alone, but for the handles";
}

TEST_F(VViewTest, PicksHandlesByPointOnly)
{
	m_pScene->m_Next.m_Boxes = {{Item(1, 28), {20, 20, 40, 40}}, {Item(2, 34), {100, 20, 40, 40}}};
	m_pSelection->Selection().Replace({Item(9)});
	Show();
	for (const std::uint32_t index : {1u, 2u})
	{
		const QPoint where(80 * static_cast<int>(index) - 40, 40);
		Hover(where);
		EXPECT_TRUE(Until([&] { return Preselected() == VIndices{index}; }));
		// Nobody takes the press here: what the handle is for stays selected.
		Click(where);
		ASSERT_TRUE(Commit());
		EXPECT_EQ(Selected(), VIndices{9});
		EXPECT_TRUE(Preselected().empty());
	}
}

TEST_F(VViewTest, SwapsTheMouseByThePreference)
{
	const auto pPreferences = std::make_shared<InMemoryHost::VPreferenceFolders>();
	m_pMapper = NVX::MakeShared<OrlexGraphics::VTesselInteractionMapper>(pPreferences, m_pDispatcher);
	CoreGraphics::VInteractionMapper::SetActive(m_pMapper);
	m_pScene->m_Next.m_Boxes = {{Item(1), {20, 20, 40, 40}}, {Item(2), {100, 20, 40, 40}}};
	Show();
	m_pView->SetCameraType(CoreGraphics::ECameraPerspective);
	const auto drag = [&](Qt::KeyboardModifiers i_Modifiers)
	{
		const float yaw = m_pView->Camera().m_Yaw;
		Press({10, 100}, i_Modifiers);
		Drag({30, 100}, i_Modifiers);
		const bool bRectangle = m_pView->MouseState() == OrlexGraphics::EMouseDragging;
		Release({30, 100}, i_Modifiers);
		EXPECT_TRUE(Commit());
		EXPECT_EQ(m_pView->Camera().m_Yaw != yaw, !bRectangle);
		return bRectangle;
	};
	for (const std::int32_t number : {1, 0, 1})
	{
		pPreferences->SetNumber(TesselPluginInterface::c_NavigationAltKey, number);
		QCoreApplication::processEvents();
		EXPECT_EQ(drag({}), number == 0);
		EXPECT_EQ(drag(Qt::AltModifier), number == 1);
	}
	// A click is a click with either of them.
	m_pView->SetCameraType(CoreGraphics::ECameraFront);
	for (const std::int32_t number : {0, 1})
	{
		pPreferences->SetNumber(TesselPluginInterface::c_NavigationAltKey, number);
		QCoreApplication::processEvents();
		for (const auto& [x, modifiers, index] :
		    {std::tuple(40, Qt::KeyboardModifiers(), 1u), {120, Qt::AltModifier, 2u}})
		{
			Click({x, 40}, modifiers);
			ASSERT_TRUE(Commit());
			EXPECT_EQ(Selected(), VIndices{index});
		}
	}
}

TEST_F(VViewTest, ShowsWhatTheMousePointsAt)
{
	for (std::uint32_t i = 0; i < 11; ++i)
		m_pScene->m_Next.m_Boxes.push_back({Item(i), QRectF(20 + 10 * i, 20, 8, 8), 0.0f, {0, 0, 1, 1}, 0,
		    std::string(1, static_cast<char>('a' + i))});
	Show();
	QSignalSpy toolTips(m_pView, &OrlexGraphics::VSceneFramebufferObject::ToolTipTextChanged);
	Hover({24, 24});
	EXPECT_TRUE(Until([&] { return Preselected() == VIndices{0}; }));
	EXPECT_EQ(m_pView->GetToolTipText(), "a");
	Hover({34, 24});
	EXPECT_TRUE(Until([&] { return Preselected() == VIndices{1}; }));
	EXPECT_EQ(m_pView->GetToolTipText(), "b");
	EXPECT_EQ(toolTips.count(), 2);

	Leave();
	EXPECT_TRUE(Until([&] { return Preselected().empty() && m_pView->GetToolTipText().isEmpty(); }));
	EXPECT_EQ(m_pView->MouseState(), OrlexGraphics::EMouseIdle);

	Press({15, 15}, Qt::AltModifier);
	Drag({135, 40}, Qt::AltModifier);
	EXPECT_TRUE(Until([&] { return Preselected().size() == 11; }));
	EXPECT_EQ(m_pView->GetToolTipText(), "a<br>b<br>c<br>d<br>e<br>f<br>g<br>h<br>i<br>j<br>...");
	EXPECT_TRUE(Selected().empty());
	Release({135, 40}, Qt::AltModifier);
	ASSERT_TRUE(Commit());
	EXPECT_EQ(Selected().size(), 11u);
	EXPECT_TRUE(m_pView->GetToolTipText().isEmpty());
}

TEST_F(VViewTest, PreselectsWhatAClickWouldChange)
{
	m_pScene->m_Next.m_Boxes = {{Item(1), {20, 20, 40, 40}}, {Item(2), {100, 20, 40, 40}}};
	m_pSelection->Selection().Replace({Item(1)});
	Show();
	const struct
	{
		Qt::KeyboardModifiers m_Modifiers;
		VIndices m_Expected;
	} rows[] = {
	    {{}, {1, 2}},
	    {Qt::ShiftModifier, {2}},
	    {Qt::ControlModifier | Qt::ShiftModifier, {1}},
	    {Qt::ControlModifier, {1, 2}},
	};
	for (const auto& rRow : rows)
	{
		Press({10, 10}, rRow.m_Modifiers | Qt::AltModifier);
		Drag({150, 70}, rRow.m_Modifiers | Qt::AltModifier);
		EXPECT_TRUE(Until([&] { return Preselected() == rRow.m_Expected; })) << rRow.m_Modifiers;
		// Back to a point where there is nothing.
		Drag({11, 11}, Qt::ShiftModifier | Qt::AltModifier);
		Release({11, 11}, Qt::ShiftModifier | Qt::AltModifier);
		ASSERT_TRUE(Commit());
		EXPECT_EQ(Selected(), VIndices{1});
	}
}

TEST_F(VViewTest, TellsAClickFromMovingTheCamera)
{
	m_pScene->m_Next.m_Boxes = {{Item(1), {20, 20, 40, 40}}};
	Show();
	m_pView->SetCameraType(CoreGraphics::ECameraPerspective);
	CoreGraphics::VCameraController& rCamera = m_pView->Camera();
	const float yaw = rCamera.m_Yaw;
	Press({100, 80});
	Drag({103, 77});
	EXPECT_EQ(rCamera.m_Yaw, yaw);
	Release({103, 77});
	EXPECT_EQ(m_pView->MouseState(), OrlexGraphics::EMouseClicked);
	ASSERT_TRUE(Commit());

	m_pSelection->Selection().Replace({Item(1)});
	Press({100, 80});
	Drag({104, 80});
	EXPECT_EQ(m_pView->MouseState(), OrlexGraphics::EMouseIdle);
	EXPECT_FLOAT_EQ(rCamera.m_Yaw, yaw + 0.8f);
	Release({104, 80});
	EXPECT_EQ(m_pView->MouseState(), OrlexGraphics::EMouseIdle) << "no click";
	EXPECT_EQ(Selected(), VIndices{1});

	// The camera has let go.
	Hover({150, 100});
	EXPECT_FLOAT_EQ(rCamera.m_Yaw, yaw + 0.8f);
}

TEST_F(VViewTest, LosesNoClickToTheMouseThatGoesOn)
{
	m_pScene->m_Next.m_Boxes = {{Item(1), {20, 20, 40, 40}}};
	Show();
	Click({40, 40});
	Hover({150, 120});
	ASSERT_TRUE(Until([&] { return Selected() == VIndices{1}; }));
	// What moves the camera or the boxes lets the click wait for the picture that the operator does not see yet.
	m_pSelection->Selection().Replace({});
	Click({40, 40});
	m_pScene->m_Next.m_Boxes[0].m_Item = Item(5);
	m_pScene->RequestRefresh();
	ASSERT_TRUE(Until([&] { return !Selected().empty(); }));
	EXPECT_EQ(Selected(), VIndices{5});
}

TEST_F(VViewTest, GivesUpARectangleWithTheFocus)
{
	m_pScene->m_Next.m_Boxes = {{Item(1), {20, 20, 40, 40}}};
	Show();
	Press({10, 10}, Qt::AltModifier);
	Drag({100, 100}, Qt::AltModifier);
	EXPECT_EQ(m_pView->MouseState(), OrlexGraphics::EMouseDragging);
	m_pView->setFocus(false);
	EXPECT_EQ(m_pView->MouseState(), OrlexGraphics::EMouseIdle);
	Release({100, 100}, Qt::AltModifier);
	EXPECT_EQ(m_pView->MouseState(), OrlexGraphics::EMouseIdle);
	EXPECT_TRUE(Selected().empty());

	// One that is to be committed outlives the mouse's leaving, not the loss of the focus.
	Press({10, 10}, Qt::AltModifier);
	Drag({100, 100}, Qt::AltModifier);
	Release({100, 100}, Qt::AltModifier);
	Leave();
	EXPECT_EQ(m_pView->MouseState(), OrlexGraphics::EMouseDragged);
	m_pView->setFocus(false);
	EXPECT_EQ(m_pView->MouseState(), OrlexGraphics::EMouseIdle);
}

} // namespace
