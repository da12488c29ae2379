#include "NVX/SelectionItemVariant.h"
#include "OrlexGraphics/item/SceneFramebufferRenderer.h"
#include "ViewFixture.h"

#include <QGuiApplication>
#include <QMetaProperty>
#include <QQmlPropertyMap>
#include <QScreen>
#include <QSignalSpy>

#include <cmath>

namespace
{

constexpr QRgb c_Background = 0xff202020;

TEST(SceneFramebufferObject, IsWhatQmlKnowsItAs)
{
	const struct
	{
		const char* m_pName;
		const char* m_pNotify;
		QVariant m_Default;
		/// Another value, and how often it is told of when it is set twice. Invalid if QML only reads it.
		QVariant m_Other = {};
		int m_Told = 0;
	} rows[] = {
	    {"scene", "", QVariant::fromValue<QObject*>(nullptr), QVariant::fromValue<QObject*>(nullptr)},
	    {"cameraGrid", "", QVariant::fromValue<QObject*>(nullptr), QVariant::fromValue<QObject*>(nullptr)},
	    {"sceneOptions", "SceneOptionsChanged", {}},
	    {"previewCamera", "PreviewCameraChanged", "", "urn:7", 2},
	    {"cameraType", "", 0, 6},
	    {"toolTipText", "ToolTipTextChanged", "", "Arm", 1},
	    {"mousePos", "MouseMoved", QPoint(), QPoint(3, 4), 1},
	    {"showCameraNumbers", "ShowCameraNumbersChanged", false, true, 1},
	    {"cameraObjects", "CamerasChanged", QVariant::fromValue(QList<QObject*>())},
	    {"subjectObjects", "SubjectsChanged", QVariant::fromValue(QList<QObject*>()),
	        QVariant::fromValue(QList<QObject*>{nullptr}), 1},
	    {"focusSelection", "", false, false},
	    {"tracking", "TrackSelectionChanged", QVariant::fromValue(OrlexGraphics::ETrackingNone),
	        QVariant::fromValue(OrlexGraphics::ETrackingTransform), 2},
	};
	OrlexGraphics::VSceneFramebufferObject item;
	const QMetaObject& rMeta = OrlexGraphics::VSceneFramebufferObject::staticMetaObject;
	ASSERT_EQ(rMeta.propertyCount() - rMeta.propertyOffset(), static_cast<int>(std::size(rows)));
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		const QMetaProperty property = rMeta.property(rMeta.propertyOffset() + static_cast<int>(&rRow - rows));
		EXPECT_STREQ(property.name(), rRow.m_pName);
		EXPECT_EQ(property.notifySignal().name(), rRow.m_pNotify);
		EXPECT_EQ(property.isWritable(), rRow.m_Other.isValid());
		if (rRow.m_Default.isValid())
		{
			EXPECT_EQ(property.read(&item), rRow.m_Default);
		}
		if (!property.isWritable())
			continue;
		std::unique_ptr<QSignalSpy> pTold;
		if (property.hasNotifySignal())
			pTold = std::make_unique<QSignalSpy>(&item, property.notifySignal());
		EXPECT_TRUE(property.write(&item, rRow.m_Other));
		EXPECT_TRUE(property.write(&item, rRow.m_Other));
		EXPECT_EQ(property.read(&item), rRow.m_Other);
		EXPECT_EQ(pTold ? pTold->count() : 0, rRow.m_Told);
	}
	const char* const c_Signals[] = {"SceneOptionsChanged", "PreviewCameraChanged", "ToolTipTextChanged", "MouseMoved",
	    "CamerasChanged", "SubjectsChanged", "ShowCameraNumbersChanged", "TrackSelectionChanged", "OnFocusChanged",
	    "OnSceneOptionsMapChanged"};
	for (const char* const& rpName : c_Signals)
		EXPECT_EQ(rMeta.method(rMeta.methodOffset() + static_cast<int>(&rpName - c_Signals)).name(), rpName);

	for (const int type : {7, -1, 1000000})
	{
		item.setProperty("cameraType", type);
		EXPECT_EQ(item.property("cameraType"), 6) << type;
	}
	// However often its keys are pressed.
	for (const auto& [factor, limit] : {std::pair(1.35, 15.0f), {0.7407407, 0.2f}, {std::nan(""), 0.2f}})
	{
		for (int i = 0; i < 40; ++i)
			item.ScaleManipulator(factor);
		EXPECT_EQ(item.Options().m_ManipulatorScale, limit);
		EXPECT_EQ(item.GetSceneOptions()->value("ManipulatorScale").toFloat(), limit);
	}
	EXPECT_EQ(item.acceptedMouseButtons(), Qt::AllButtons);
	EXPECT_TRUE(item.acceptHoverEvents());
	EXPECT_TRUE(item.mirrorVertically());
	item.SetSubjectObjects({});
}

TEST_F(VViewTest, ADoubleClickPreviewsTheSelectedCamera)
{
	Show();
	m_pScene->SelectCamera("urn:7", false);
	m_pScene->SelectCamera("urn:8", true);
	EXPECT_EQ(m_pSelection->PreSelection().Items(), (std::vector<NVX::ISelectionItem>{{1, 0, 0, "urn:8"}}));
	Mouse(QEvent::MouseButtonDblClick, {40, 40}, Qt::LeftButton, Qt::LeftButton);
	EXPECT_EQ(m_pView->GetPreviewCamera(), "urn:7");
	m_pScene->SelectCamera("", false);
	Mouse(QEvent::MouseButtonDblClick, {40, 40}, Qt::LeftButton, Qt::LeftButton);
	EXPECT_EQ(m_pView->GetPreviewCamera(), "");
}

TEST_F(VViewTest, DrawsTheBackgroundColour)
{
	Show(std::make_shared<OrlexGraphics::VOrlexScene>(m_pShaders, m_pSelection, nullptr, m_pDispatcher, false));
	EXPECT_TRUE(Until([&] { return Pixel(100, 80) == c_Background; }));

	// As QML writes it.
	SetOption("BackgroundColorRGB", 0x4080c0);
	EXPECT_TRUE(Until([&] { return Pixel(100, 80) == 0xff4080c0; }));
}

TEST_F(VViewTest, DrawsPassesInTheirOrder)
{
	const QVector4D red(1, 0, 0, 1), green(0, 1, 0, 1), blue(0, 0, 1, 1);
	m_pScene->m_Next.m_Boxes = {
	    {Item(1), {20, 20, 20, 20}, 100.0f, red},
	    {Item(2), {30, 20, 20, 20}, 0.0f, green, OrlexGraphics::EPassTransparent},
	    // Behind all, yet drawn over it.
	    {Item(3), {20, 30, 20, 20}, -100.0f, blue, OrlexGraphics::EPassOverlay},
	};
	Show();
	ASSERT_TRUE(Until([&] { return Pixel(25, 25) == 0xffff0000; }));
	EXPECT_EQ(Pixel(35, 25), 0xffff0000) << "the depth of the first pass holds in the second one";
	EXPECT_EQ(Pixel(45, 25), 0xff00ff00);
	EXPECT_EQ(Pixel(25, 35), 0xff0000ff);
	EXPECT_EQ(Pixel(60, 60), c_Background);

	SetOption("3D", false);
	ASSERT_TRUE(Until([&] { return Pixel(25, 25) == c_Background; }));
	EXPECT_EQ(Pixel(25, 35), 0xff0000ff);
}

TEST_F(VViewTest, ShowsTheMeanOfEachPixelsSamples)
{
	// From the middle of a pixel of the display, and from three quarters down: two and one of four samples.
	const double pixel = 1.0 / QGuiApplication::primaryScreen()->devicePixelRatio();
	m_pScene->m_Next.m_Boxes = {{Item(1), {20 + 0.5 * pixel, 20 + 0.75 * pixel, 40, 40}, 0.0f, {1, 1, 1, 1}}};
	Show();
	ASSERT_TRUE(Until([&] { return Pixel(40, 40) == 0xffffffff; }));
	const auto mean = [](double i_Share) { return 0x20 + i_Share * (0xff - 0x20); };
	EXPECT_NEAR(qRed(Pixel(20, 40)), mean(0.5), 1.0);
	EXPECT_NEAR(qRed(Pixel(40, 20)), mean(0.25), 1.0);
	EXPECT_NEAR(qRed(Pixel(40, 60)), mean(0.75), 1.0);
	EXPECT_EQ(Pixel(62, 62), c_Background);

	// Over white, as the window is.
	const auto over = [](int i_Channel, double i_Opacity) { return i_Opacity * i_Channel + (1 - i_Opacity) * 0xff; };
	m_pView->setOpacity(0.25);
	EXPECT_TRUE(Until([&] { return std::abs(qRed(Pixel(62, 62)) - over(0x20, 0.25)) <= 1.0; }));
	m_pView->setOpacity(1.0);

	// Views of cameras have one sample a pixel, once they are of another size.
	SetOption("CameraView", true);
	Resize(c_Width, c_Height - 20);
	EXPECT_TRUE(Until([&] { return m_pView->height() < c_Height && Pixel(20, 40) == c_Background; }));
	SetOption("CameraView", false);
	Resize(c_Width, c_Height);
	EXPECT_TRUE(Until([&] { return std::abs(qRed(Pixel(20, 40)) - mean(0.5)) <= 1.0; }));
}

TEST_F(VViewTest, OutlinesWhatIsSelectedAndWhatTheMousePointsAt)
{
	m_pScene->m_Next.m_Boxes = {
	    {Item(1), {20, 20, 40, 40}}, {Item(2), {100, 20, 40, 40}}, {Item(3), {20, 100, 40, 40}}};
	Show();
	ASSERT_TRUE(Until([&] { return Pixel(40, 40) == 0xff0000ff; }));
	const QImage plain = Grab();

	// Fill of a quarter of grey, and an edge of three quarters of white.
	m_pSelection->Selection().Replace({Item(1)});
	ASSERT_TRUE(Until([&] { return Pixel(40, 40) == 0xff4040ff; }));
	EXPECT_EQ(Pixel(120, 40), 0xff0000ff) << "the other one is not selected";
	EXPECT_GE(qRed(Pixel(40, 20)), 200) << "edge";
	EXPECT_EQ(Pixel(10, 10), c_Background);
	EXPECT_EQ(Pixel(80, 40), c_Background);

	// The first of two is the primary one: hatched.
	m_pSelection->Selection().Add({Item(2)});
	ASSERT_TRUE(Until([&] { return Pixel(120, 40) == 0xff4040ff; }));
	int hatched = 0;
	for (int x = 30; x < 50; ++x)
		hatched += qRed(Pixel(x, 40)) > 100 ? 1 : 0;
	EXPECT_EQ(hatched, 5) << "one diagonal of four";

	m_pSelection->Selection().Replace({});
	ASSERT_TRUE(Until([&] { return Grab() == plain; })) << "nothing stays";

	const struct
	{
		Qt::KeyboardModifiers m_Modifiers;
		QRgb m_Fill;
	} rows[] = {
	    {{}, 0xff4020ff},
	    {Qt::ShiftModifier, 0xff00ffff},
	    {Qt::ControlModifier | Qt::ShiftModifier, 0xffff00ff},
	    {Qt::ControlModifier, 0xff00ffff},
	};
	// Of what is selected, so that each of the states means something.
	for (const auto& rRow : rows)
	{
		const bool bSubtract = rRow.m_Modifiers == (Qt::ControlModifier | Qt::ShiftModifier);
		m_pSelection->Selection().Replace(bSubtract ? std::vector{Item(3)} : std::vector<NVX::ISelectionItem>());
		Mouse(QEvent::MouseMove, {40, 120}, Qt::NoButton, Qt::NoButton, rRow.m_Modifiers);
		EXPECT_TRUE(Until([&] { return Pixel(40, 120) == rRow.m_Fill; }))
		    << std::hex << Pixel(40, 120) << " instead of " << rRow.m_Fill;
		Hover({190, 150});
		EXPECT_TRUE(Until([&] { return Preselected().empty(); }));
	}
}

TEST_F(VViewTest, TakesOtherSamplesWithTheNextFramebuffer)
{
	// An edge in the middle of a column of pixels.
	m_pScene->m_Next.m_Boxes = {{Item(1), QRectF(20.5, 20, 40, 40)}};
	Show();
	const auto set = [&](const char* i_pKey, bool i_bValue)
	{
		SetOption(i_pKey, i_bValue);
		Grab();
	};
	const auto isSmooth = [&]
	{
		const int edge = qBlue(Pixel(20, 40));
		return edge > 0x40 && edge < 0xe0;
	};
	ASSERT_TRUE(Until([&] { return Pixel(40, 40) == 0xff0000ff; }));
	EXPECT_TRUE(isSmooth());
	// Nobody asks for another framebuffer while there is no 3D.
	set("CameraView", true);
	set("3D", false);
	set("Distort3D", true);
	set("Distort3D", false);
	set("3D", true);
	set("CameraView", false);
	EXPECT_TRUE(isSmooth());
	set("CameraView", true);
	set("Distort3D", true);
	set("CameraView", false);
	EXPECT_FALSE(isSmooth()) << "the one of the camera view";
	set("Distort3D", false);
	EXPECT_TRUE(isSmooth());
}

TEST_F(VViewTest, FollowsTheUpAxisOfFrameAndOperator)
{
	Show();
	EXPECT_FALSE(m_pView->Options().m_bYUp);
	m_pScene->m_Next.m_bYUp = true;
	m_pScene->RequestRefresh();
	EXPECT_TRUE(Until([&] { return m_pView->GetSceneOptions()->value("YUp").toBool(); }));
	EXPECT_TRUE(m_pScene->YUp());
	EXPECT_TRUE(m_pView->Camera().m_bYUp);

	m_pScene->m_Next.m_bYUp.reset();
	SetOption("YUp", false);
	EXPECT_FALSE(m_pScene->YUp());
	const int refreshes = m_pScene->m_Refreshes;
	m_pScene->RequestRefresh();
	ASSERT_TRUE(Until([&] { return m_pScene->m_Refreshes > refreshes; }));
	EXPECT_FALSE(m_pView->Options().m_bYUp) << "a frame without an up axis leaves it as it was";
}

TEST_F(VViewTest, FramesTheSelection)
{
	m_pScene->m_Next.m_Boxes = {{Item(1), {20, 20, 40, 40}}, {Item(2), {100, 20, 40, 40}}};
	m_pSelection->Selection().Replace({Item(2)});
	Show();
	EXPECT_FALSE(m_pView->property("focusSelection").toBool());
	m_pView->setProperty("focusSelection", false);
	m_pView->setProperty("focusSelection", true);
	EXPECT_FALSE(m_pView->property("focusSelection").toBool());
	CoreGraphics::VCameraController& rCamera = m_pView->Camera();
	ASSERT_TRUE(Until([&] { return !rCamera.m_Centre.isNull(); }));
	// The box's centre is 20 pixels to the right and 40 up: 80 and 160 mm.
	EXPECT_NEAR(rCamera.Orientation().map(rCamera.m_Centre).x(), 80.0f, 0.1f);
	EXPECT_NEAR(rCamera.Orientation().map(rCamera.m_Centre).y(), 160.0f, 0.1f);
	const float radius = 0.5f * 4.0f * std::sqrt(2.0f) * 40.0f + 1.0f;
	EXPECT_NEAR(rCamera.m_OrthographicScale, 2.0f * (radius + 250.0f) / c_Height, 0.01f);

	m_pSelection->Selection().Replace({});
	const QVector3D centre = rCamera.m_Centre;
	const QMatrix4x4 view = rCamera.m_View;
	m_pView->setProperty("focusSelection", true);
	m_pView->SetTracking(OrlexGraphics::ETrackingSelection);
	const int refreshes = m_pScene->m_Refreshes;
	m_pScene->RequestRefresh();
	ASSERT_TRUE(Until([&] { return m_pScene->m_Refreshes > refreshes; }));
	EXPECT_EQ(rCamera.m_Centre, centre) << "no bounds, no change";
	EXPECT_EQ(rCamera.m_View, view);
}

TEST_F(VViewTest, TracksTheSelection)
{
	m_pScene->m_Next.m_Boxes = {{Item(1), {20, 20, 40, 40}}, {Item(2), {100, 20, 40, 40}}};
	m_pSelection->Selection().Replace({Item(1)});
	Show();
	CoreGraphics::VCameraController& rCamera = m_pView->Camera();
	const auto centreX = [&] { return rCamera.Orientation().map(rCamera.m_Centre).x(); };
	const float scale = rCamera.m_OrthographicScale;
	QSignalSpy changed(m_pView, &OrlexGraphics::VSceneFramebufferObject::TrackSelectionChanged);

	m_pView->SetTracking(OrlexGraphics::ETrackingSelectionThen);
	ASSERT_TRUE(Until([&] { return std::abs(centreX() + 240.0f) < 0.1f; }));
	m_pSelection->Selection().Replace({Item(2)});
	m_pView->SetTracking(OrlexGraphics::ETrackingSelection);
	ASSERT_TRUE(Until([&] { return std::abs(centreX() - 80.0f) < 0.1f; }));
	m_pSelection->Selection().Replace({Item(1)});
	ASSERT_TRUE(Until([&] { return std::abs(centreX() + 240.0f) < 0.1f; }));
	EXPECT_EQ(rCamera.m_OrthographicScale, scale) << "the distance stays the operator's";

	m_pView->SetTracking(OrlexGraphics::ETrackingTransform);
	ASSERT_TRUE(Until([&] { return !rCamera.m_FrameOfReference.isIdentity(); }));
	EXPECT_TRUE(rCamera.m_Centre.isNull());
	EXPECT_EQ(rCamera.m_Distance, 1000.0f);
	m_pView->SetTracking(OrlexGraphics::ETrackingNone);
	ASSERT_TRUE(Until([&] { return rCamera.m_FrameOfReference.isIdentity(); }));
	EXPECT_EQ(rCamera.m_Distance, 7000.0f);
	EXPECT_EQ(changed.count(), 4);
}

TEST_F(VViewTest, PlacesLabelsOverTheView)
{
	m_pScene->m_Next.m_SubjectLabels = {{"Actor", {0, 0, 0}, Item(1)}};
	m_pScene->m_Next.m_PropLabels = {{"Ball", {0, 0, 200}, Item(2)}};
	Show();
	ASSERT_TRUE(Until([&] { return m_pView->GetSubjectObjects().size() == 2; }));
	EXPECT_EQ(m_pView->GetSubjectObjects()[0]->property("name"), "Actor");
	EXPECT_EQ(m_pView->GetSubjectObjects()[1]->property("selectionItem").value<NVX::ISelectionItem>(), Item(2));
	// 4 mm are a pixel; a label stands 100 mm and 20 pixels higher.
	EXPECT_EQ(m_pView->GetSubjectObjects()[0]->property("position").value<QVector3D>().toPointF().y(), -45.0);
	QSignalSpy subjects(m_pView, &OrlexGraphics::VSceneFramebufferObject::SubjectsChanged);
	SetOption("PropSubject-Enabled", false);
	EXPECT_EQ(m_pView->GetSubjectObjects().size(), 1);
	EXPECT_EQ(subjects.count(), 1);
}

/// In a process without OpenGL, see RenderLoopTest.
TEST_F(VViewTest, DISABLED_SaysThatThereIsNoOpenGL)
{
	Show(std::make_shared<OrlexGraphics::VOrlexScene>(m_pShaders, m_pSelection, nullptr, m_pDispatcher, false));
	const auto textPixels = [&]
	{
		const QImage image = Grab();
		int pixels = 0;
		for (int y = 0; y < image.height(); ++y)
			for (int x = 0; x < image.width(); ++x)
				pixels += image.pixel(x, y) != c_Background ? 1 : 0;
		return pixels;
	};
	EXPECT_TRUE(Until([&] { return textPixels() > 200 && textPixels() < 20000; })) << textPixels();
	EXPECT_EQ(OrlexGraphics::VSceneFramebufferRenderer::MadeCount(), 0u);
	Resize(300, 100);
	EXPECT_TRUE(Until([&] { return Grab().width() == 300 && textPixels() > 200 && textPixels() < 20000; }));
	Click({50, 50});
	Close();
}

/// As often as RETARGET_TEST_CYCLES says: each cycle draws, hides, resizes, docks elsewhere and loads anew.
TEST_F(VViewTest, EndsItsRenderersWithTheirWindows)
{
	using OrlexGraphics::VSceneFramebufferRenderer;
	const std::uint64_t living = VSceneFramebufferRenderer::LivingCount();
	const std::uint64_t made = VSceneFramebufferRenderer::MadeCount();
	const int cycles =
	    qEnvironmentVariableIsSet("RETARGET_TEST_CYCLES") ? qEnvironmentVariableIntValue("RETARGET_TEST_CYCLES") : 6;
	const auto isSelected = [&] { return Pixel(40, 40) == 0xff4040ff; };
	// A dock is another window, with another context.
	const auto dock = [&](auto& io_rView, auto& io_rDock)
	{
		// A window that is shown is the window manager's, which would take it out of its new parent.
		io_rView.hide();
		io_rView.setParent(&io_rDock);
		m_pScene->RequestRefresh();
		io_rDock.resize(c_Width, c_Height);
		io_rView.resize(c_Width, c_Height);
		io_rView.show();
		io_rDock.show();
		EXPECT_TRUE(Until(isSelected));
		io_rView.hide();
		io_rView.setParent(static_cast<decltype(&io_rDock)>(nullptr));
		io_rView.show();
		EXPECT_TRUE(Until(isSelected));
	};
	m_pSelection->Selection().Replace({Item(1)});
	for (int i = 0; i < cycles && !HasFailure(); ++i)
	{
		SCOPED_TRACE(i);
		m_pScene->m_Next.m_Boxes = {{Item(1), {20, 20, 40, 40}}};
		Show();
		EXPECT_TRUE(Until(isSelected));
		// It goes while this is loaded and drawn.
		m_pScene->m_Next.m_Boxes.push_back({Item(2), {100.0, 20.0 + i % 30, 40, 40}});
		m_pScene->RequestRefresh();
		Resize(0, 0);
		SetVisible(false);
		Resize(300, 200);
		SetVisible(true);
		EXPECT_TRUE(Until([&] { return Pixel(290, 190) == c_Background && Pixel(170, 75) == 0xff0000ff; }));
		if (m_pWidget)
		{
			QWidget window;
			dock(*m_pWidget, window);
		}
		else
		{
			QWindow window;
			dock(*m_pWindow, window);
		}
		// Away in the middle of a pick.
		Hover({40, 40});
		m_pScene->RequestRefresh();
		Close();
		EXPECT_EQ(VSceneFramebufferRenderer::LivingCount(), living);
		EXPECT_EQ(m_pScene.use_count(), 1);
	}
	EXPECT_GE(VSceneFramebufferRenderer::MadeCount(), made + static_cast<std::uint64_t>(cycles));
}

} // namespace
