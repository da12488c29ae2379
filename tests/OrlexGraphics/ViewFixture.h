#pragma once

#include "CoreGraphics/ShaderLibrary.h"
#include "InMemoryHost/Selection.h"
#include "OrlexGraphics/OrlexScene.h"
#include "OrlexGraphics/SceneFramebufferObject.h"
#include "TesselPluginInterface/IDispatcher.h"

#include <QImage>
#include <QQuickItem>
#include <QQuickWidget>
#include <QSignalSpy>
#include <QTest>
#include <gtest/gtest.h>

#include <functional>

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

/// A window with one view, 200 by 160 pixels, of a scene.
class VViewTest : public testing::Test
{
protected:
	static constexpr int c_Width = 200;
	static constexpr int c_Height = 160;

	void Show(std::shared_ptr<OrlexGraphics::VOrlexScene> i_pScene)
	{
		m_pScene = std::move(i_pScene);
		m_pWidget = std::make_unique<QQuickWidget>();
		m_pWidget->setResizeMode(QQuickWidget::SizeRootObjectToView);
		m_pView = new OrlexGraphics::VSceneFramebufferObject;
		m_pView->SetScene(m_pScene.get());
		m_pWidget->setContent(QUrl(), nullptr, m_pView);
		m_pWidget->resize(c_Width, c_Height);
		m_pWidget->show();
		ASSERT_TRUE(QTest::qWaitForWindowExposed(m_pWidget.get()));
	}

	/// Runs the event loop until it holds.
	static bool Until(const std::function<bool()>& i_rCondition) { return QTest::qWaitFor(i_rCondition, 10000); }

	const std::shared_ptr<VEventLoopDispatcher> m_pDispatcher = std::make_shared<VEventLoopDispatcher>();
	const std::shared_ptr<InMemoryHost::VSelectionManager> m_pSelection =
	    std::make_shared<InMemoryHost::VSelectionManager>();
	const std::shared_ptr<CoreGraphics::VShaderLibrary> m_pShaders = std::make_shared<CoreGraphics::VShaderLibrary>();
	std::shared_ptr<OrlexGraphics::VOrlexScene> m_pScene;
	std::unique_ptr<QQuickWidget> m_pWidget;
	/// The widget owns it.
	OrlexGraphics::VSceneFramebufferObject* m_pView = nullptr;
};
