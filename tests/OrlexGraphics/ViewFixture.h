#pragma once

#include "CoreGraphics/CameraController.h"
#include "CoreGraphics/InteractionMapper.h"
#include "CoreGraphics/SelectableProgram.h"
#include "CoreGraphics/ShaderLibrary.h"
#include "CoreGraphics/Shapes.h"
#include "Flow2Graphics/FlowScene.h"
#include "InMemoryHost/Selection.h"
#include "OrlexGraphics/frame/IRenderType.h"
#include "OrlexGraphics/item/SceneFramebufferObject.h"
#include "TesselPluginInterface/IDispatcher.h"

#include <QImage>
#include <QQuickView>
#include <QQuickWidget>
#include <gtest/gtest.h>

#include <atomic>
#include <functional>
#include <optional>

/// Runs what is posted in the event loop.
class VEventLoopDispatcher : public TesselPluginInterface::IDispatcher
{
public:
	void Post(std::function<void()> i_Callback) override
	{
		QMetaObject::invokeMethod(&m_Context, std::move(i_Callback), Qt::QueuedConnection);
	}

private:
	QObject m_Context;
};

/// A box that faces the eye of the front view.
struct VBox
{
	NVX::ISelectionItem m_Item;
	/// Pixels of the view.
	QRectF m_Place;
	/// Millimetres towards the eye.
	float m_Height = 0.0f;
	QVector4D m_Colour{0.0f, 0.0f, 1.0f, 1.0f};
	std::uint32_t m_Pass = OrlexGraphics::EPassOpaque;
	std::string m_Name = {};
	/// What fits into it is drawn instead.
	bool m_bSphere = false;
};

/// What the user interface thread hands to a frame.
struct VBoxFrame
{
	std::vector<VBox> m_Boxes;
	std::vector<OrlexGraphics::VSubjectLabel> m_SubjectLabels;
	std::vector<OrlexGraphics::VSubjectLabel> m_PropLabels;
	std::optional<bool> m_bYUp;
};

/// Of boxes, and nothing else.
class VBoxScene : public Flow2Graphics::VFlowScene
{
public:
	using VFlowScene::VFlowScene;

	void InitialiseGL() override;
	bool Synchronise() override;
	void Refresh() override;

	/// Taken with the exchange before the next frame update.
	VBoxFrame m_Next;
	/// Of the view.
	QSize m_Size;
	std::atomic<int> m_Refreshes = 0;
	/// Frame updates before which OpenGL had complained.
	static std::atomic<int> s_GLErrors;
	using VFlowScene::m_bExactPick;

private:
	VBoxFrame m_Frame;
	std::shared_ptr<OrlexGraphics::IRenderType> m_pBoxes;
};

/// A window with one view, 200 by 160 pixels, from the front, of a scene of boxes. With RETARGET_TEST_VIEW in the
/// environment it is a window of Qt Quick's own, which may draw on another thread, otherwise a widget.
class VViewTest : public testing::Test
{
protected:
	static constexpr int c_Width = 200;
	static constexpr int c_Height = 160;

	VViewTest();
	~VViewTest() override;

	void SetUp() override
	{
		if (qEnvironmentVariableIsSet("TSAN_OPTIONS"))
			GTEST_SKIP() << "ThreadSanitizer does not see how Qt's threads wait for each other; HandOverTest is for it";
	}

	void Show();
	void Show(const std::shared_ptr<OrlexGraphics::VOrlexScene>& i_rpScene);

	/// Runs the event loop until it holds.
	static bool Until(const std::function<bool()>& i_rCondition);
	QImage Grab();
	/// Of what is shown now, by item pixels.
	QRgb Pixel(int i_X, int i_Y);
	/// As QML does it.
	void SetOption(const char* i_pKey, const QVariant& i_rValue);
	void Leave();
	void Resize(int i_Width, int i_Height);
	void SetVisible(bool i_bVisible);
	void Close();

	void Mouse(QEvent::Type i_Type, const QPoint& i_rPos, Qt::MouseButton i_Button, Qt::MouseButtons i_Buttons,
	    Qt::KeyboardModifiers i_Modifiers = {});
	void Hover(const QPoint& i_rPos) { Mouse(QEvent::MouseMove, i_rPos, Qt::NoButton, Qt::NoButton); }
	void Press(const QPoint& i_rPos, Qt::KeyboardModifiers i_Modifiers = {})
	{
		Mouse(QEvent::MouseButtonPress, i_rPos, Qt::LeftButton, Qt::LeftButton, i_Modifiers);
	}
	void Drag(const QPoint& i_rPos, Qt::KeyboardModifiers i_Modifiers = {})
	{
		Mouse(QEvent::MouseMove, i_rPos, Qt::NoButton, Qt::LeftButton, i_Modifiers);
	}
	void Release(const QPoint& i_rPos, Qt::KeyboardModifiers i_Modifiers = {})
	{
		Mouse(QEvent::MouseButtonRelease, i_rPos, Qt::LeftButton, Qt::NoButton, i_Modifiers);
	}
	void Click(const QPoint& i_rPos, Qt::KeyboardModifiers i_Modifiers = {})
	{
		Press(i_rPos, i_Modifiers);
		Release(i_rPos, i_Modifiers);
	}
	/// Waits until a click or a rectangle has been committed.
	bool Commit();

	/// What is selected, by element index.
	std::vector<std::uint32_t> Selected() const;
	std::vector<std::uint32_t> Preselected() const;

	const std::shared_ptr<VEventLoopDispatcher> m_pDispatcher = std::make_shared<VEventLoopDispatcher>();
	const std::shared_ptr<InMemoryHost::VSelectionManager> m_pSelection =
	    std::make_shared<InMemoryHost::VSelectionManager>();
	const std::shared_ptr<CoreGraphics::VShaderLibrary> m_pShaders = std::make_shared<CoreGraphics::VShaderLibrary>();
	std::shared_ptr<CoreGraphics::VInteractionMapper> m_pMapper;
	std::shared_ptr<VBoxScene> m_pScene;
	std::unique_ptr<QQuickWidget> m_pWidget;
	std::unique_ptr<QQuickView> m_pWindow;
	/// The window owns it.
	OrlexGraphics::VSceneFramebufferObject* m_pView = nullptr;
};

NVX::ISelectionItem Item(std::uint32_t i_Index, std::uint32_t i_Kind = NVX::ESelectionTargetSegment);
std::vector<std::uint32_t> Indices(const std::vector<NVX::ISelectionItem>& i_rItems);
