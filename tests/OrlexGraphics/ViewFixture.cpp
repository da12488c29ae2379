#include "ViewFixture.h"

#include "../WaitFor.h"

#include "CoreGraphics/RenderContext.h"
#include "OrlexGraphics/item/TesselInteractionMapper.h"
#include "OrlexGraphics/picking/SelectionRegistry.h"
#include "OrlexGraphics/stage/SphereHelper.h"

#include <QMouseEvent>
#include <QOpenGLFunctions>
#include <QQmlPropertyMap>
#include <QQuickItem>
#include <QQuickWindow>
#include <QTest>

#include <cmath>

namespace
{

class VBoxes : public OrlexGraphics::IRenderType
{
public:
	VBoxes(CoreGraphics::VShaderLibrary& io_rLibrary, std::shared_ptr<OrlexGraphics::VSelectionRegistry> i_pRegistry,
	    std::shared_ptr<OrlexGraphics::VSphereHelper> i_pSpheres)
	    : m_pRegistry(std::move(i_pRegistry)), m_pSpheres(std::move(i_pSpheres)),
	      m_Program(CoreGraphics::VSelectableProgram::Make(io_rLibrary, "Simple3DModelColour", "Colour"))
	{
		m_State.m_bDepthTest = true;
		m_SelectionState = CoreGraphics::MakeSelectionState(m_State);
	}

	void Update(const std::vector<VBox>& i_rBoxes, const QSize& i_rView)
	{
		// Of all that was drawn since the last update.
		if (QOpenGLContext::currentContext()->functions()->glGetError() != GL_NO_ERROR)
			++VBoxScene::s_GLErrors;
		constexpr float c_Scale = 4.0f;
		m_Drawn.clear();
		CoreGraphics::VCameraController front;
		front.m_Type = CoreGraphics::ECameraFront;
		const QMatrix4x4 toWorld = front.Orientation().inverted();
		for (const VBox& rBox : i_rBoxes)
		{
			const QPointF centre = rBox.m_Place.center() - QPointF(0.5 * i_rView.width(), 0.5 * i_rView.height());
			const QVector3D eye(
			    c_Scale * static_cast<float>(centre.x()), -c_Scale * static_cast<float>(centre.y()), rBox.m_Height);
			VDrawn drawn;
			drawn.m_Id = rBox.m_Item.m_Kind == 0 ? CoreGraphics::VSelectionId() : m_pRegistry->GetId(rBox.m_Item);
			if (!rBox.m_Name.empty())
				m_pRegistry->Allocate(rBox.m_Item, rBox.m_Name);
			drawn.m_Transform = toWorld;
			drawn.m_Transform.translate(eye);
			drawn.m_Transform.scale(c_Scale * static_cast<float>(rBox.m_Place.width()),
			    c_Scale * static_cast<float>(rBox.m_Place.height()), 1.0f);
			drawn.m_Colour = rBox.m_Colour;
			drawn.m_Pass = rBox.m_Pass;
			if (rBox.m_bSphere)
				drawn.m_Sphere.emplace(toWorld.map(eye), 0.5f * c_Scale * static_cast<float>(rBox.m_Place.width()));
			const float radius =
			    0.5f * c_Scale * static_cast<float>(std::hypot(rBox.m_Place.width(), rBox.m_Place.height())) + 1.0f;
			m_pRegistry->SetItemBound(rBox.m_Item, QVector4D(toWorld.map(eye), radius));
			m_pRegistry->SetItemMatrix(rBox.m_Item, drawn.m_Transform);
			m_Drawn.push_back(drawn);
		}
	}

	void Render(CoreGraphics::VRenderContext& io_rContext, const OrlexGraphics::VSceneOptions& /*i_rOptions*/,
	    std::uint32_t i_Pass) override
	{
		if (i_Pass == OrlexGraphics::EPassOpaque)
			RenderSpheres(io_rContext);
		const bool bSelection = io_rContext.m_Mode != CoreGraphics::ERenderNormal;
		if (!io_rContext.UseProgram(m_Program.Get(bSelection)))
			return;
		io_rContext.ApplyState(bSelection ? m_SelectionState : m_State);
		io_rContext.BindVertices(m_Box.m_Vertices);
		for (const VDrawn& rDrawn : m_Drawn)
		{
			if (rDrawn.m_Pass != i_Pass || rDrawn.m_Sphere
			    || (bSelection && (rDrawn.m_Id.m_Id == 0 || m_pRegistry->IsHidden(rDrawn.m_Id, io_rContext.m_Mode))))
				continue;
			if (bSelection)
				m_Program.SetId(io_rContext, rDrawn.m_Id);
			io_rContext.SetUniform(m_ModelTransform, rDrawn.m_Transform);
			io_rContext.SetUniform(m_ModelColour, rDrawn.m_Colour);
			io_rContext.DrawElements(GL_TRIANGLES, m_Box.m_Indices);
		}
	}

private:
	struct VDrawn
	{
		QMatrix4x4 m_Transform;
		QVector4D m_Colour;
		CoreGraphics::VSelectionId m_Id;
		std::uint32_t m_Pass = 0;
		std::optional<QVector4D> m_Sphere;
	};

	void RenderSpheres(CoreGraphics::VRenderContext& io_rContext)
	{
		m_pSpheres->Begin(io_rContext);
		for (const VDrawn& rDrawn : m_Drawn)
			if (rDrawn.m_Sphere)
				m_pSpheres->Draw(io_rContext, *rDrawn.m_Sphere, rDrawn.m_Id, rDrawn.m_Colour, 3);
		m_pSpheres->End(io_rContext);
	}

	const std::shared_ptr<OrlexGraphics::VSelectionRegistry> m_pRegistry;
	const std::shared_ptr<OrlexGraphics::VSphereHelper> m_pSpheres;
	CoreGraphics::VSelectableProgram m_Program;
	CoreGraphics::VShape m_Box = CoreGraphics::MakeBox(false);
	CoreGraphics::VUniform m_ModelTransform{"u_ModelTransform"};
	CoreGraphics::VUniform m_ModelColour{"u_ModelColour"};
	CoreGraphics::VRenderState m_State;
	CoreGraphics::VRenderState m_SelectionState;
	std::vector<VDrawn> m_Drawn;
};

} // namespace

NVX::ISelectionItem Item(std::uint32_t i_Index, std::uint32_t i_Kind)
{
	return {i_Kind, 0x0fffffff, i_Index, {}};
}

std::vector<std::uint32_t> Indices(const std::vector<NVX::ISelectionItem>& i_rItems)
{
	std::vector<std::uint32_t> indices;
	for (const NVX::ISelectionItem& rItem : i_rItems)
		indices.push_back(rItem.m_ElementIndex);
	return indices;
}

std::atomic<int> VBoxScene::s_GLErrors = 0;

void VBoxScene::InitialiseGL()
{
	VFlowScene::InitialiseGL();
	if (m_pBoxes)
		return;
	m_pBoxes = std::make_shared<VBoxes>(*m_pShaderLibrary, m_pRegistry, m_pSphereHelper);
	m_RenderList.push_back(m_pBoxes);
}

bool VBoxScene::Synchronise()
{
	m_Frame = m_Next;
	return VFlowScene::Synchronise();
}

void VBoxScene::Refresh()
{
	++m_Refreshes;
	m_pRegistry->Reset();
	static_cast<VBoxes&>(*m_pBoxes).Update(m_Frame.m_Boxes, m_Size);
	m_Overlay.m_SubjectLabels = m_Frame.m_SubjectLabels;
	m_Overlay.m_PropLabels = m_Frame.m_PropLabels;
	if (m_Frame.m_bYUp)
		m_bFrameYUp = *m_Frame.m_bYUp;
	VOrlexScene::Refresh();
}

VViewTest::VViewTest()
{
	m_pMapper = NVX::MakeShared<OrlexGraphics::VTesselInteractionMapper>(nullptr, m_pDispatcher);
	CoreGraphics::VInteractionMapper::SetActive(m_pMapper);
	m_pScene = std::make_shared<VBoxScene>(m_pShaders, m_pSelection, nullptr, m_pDispatcher, false);
	m_pScene->m_Size = QSize(c_Width, c_Height);
}

VViewTest::~VViewTest()
{
	Close();
	EXPECT_EQ(VBoxScene::s_GLErrors, 0);
}

void VViewTest::Close()
{
	m_pWidget.reset();
	m_pWindow.reset();
}

void VViewTest::Show()
{
	Show(m_pScene);
}

void VViewTest::Show(const std::shared_ptr<OrlexGraphics::VOrlexScene>& i_rpScene)
{
	m_pView = new OrlexGraphics::VSceneFramebufferObject;
	m_pView->SetScene(i_rpScene.get());
	m_pView->SetCameraType(CoreGraphics::ECameraFront);
	const auto show = [&](auto& io_rpWindow)
	{
		using VWindow = std::remove_reference_t<decltype(*io_rpWindow)>;
		io_rpWindow = std::make_unique<VWindow>();
		io_rpWindow->setResizeMode(VWindow::SizeRootObjectToView);
		io_rpWindow->setContent(QUrl(), nullptr, m_pView);
		io_rpWindow->resize(c_Width, c_Height);
		io_rpWindow->show();
		return QTest::qWaitForWindowExposed(io_rpWindow.get());
	};
	ASSERT_TRUE(qEnvironmentVariableIsSet("RETARGET_TEST_VIEW") ? show(m_pWindow) : show(m_pWidget));
	ASSERT_TRUE(Until([&] { return m_pScene->m_Refreshes > 0 || i_rpScene != m_pScene; }));
}

bool VViewTest::Until(const std::function<bool()>& i_rCondition)
{
	return WaitFor(i_rCondition, 10000);
}

void VViewTest::Mouse(QEvent::Type i_Type, const QPoint& i_rPos, Qt::MouseButton i_Button, Qt::MouseButtons i_Buttons,
    Qt::KeyboardModifiers i_Modifiers)
{
	QObject* const pWindow = m_pWindow ? static_cast<QObject*>(m_pWindow.get()) : m_pWidget.get();
	const QPoint global = m_pWindow ? m_pWindow->mapToGlobal(i_rPos) : m_pWidget->mapToGlobal(i_rPos);
	QMouseEvent event(i_Type, i_rPos, global, i_Button, i_Buttons, i_Modifiers);
	QCoreApplication::sendEvent(pWindow, &event);
}

QImage VViewTest::Grab()
{
	return m_pWindow ? m_pWindow->grabWindow() : m_pWidget->grabFramebuffer();
}

QRgb VViewTest::Pixel(int i_X, int i_Y)
{
	const QImage image = Grab();
	const double ratio = m_pView->window()->effectiveDevicePixelRatio();
	const QPoint pixel(static_cast<int>(i_X * ratio), static_cast<int>(i_Y * ratio));
	// A window that is being resized may not be so large yet.
	return image.valid(pixel) ? image.pixel(pixel) : 0;
}

void VViewTest::SetOption(const char* i_pKey, const QVariant& i_rValue)
{
	m_pView->GetSceneOptions()->insert(i_pKey, i_rValue);
	m_pView->OnSceneOptionsMapChanged(i_pKey, i_rValue);
}

void VViewTest::Leave()
{
	QEvent event(QEvent::Leave);
	QCoreApplication::sendEvent(m_pWindow ? static_cast<QObject*>(m_pWindow.get()) : m_pWidget.get(), &event);
}

void VViewTest::Resize(int i_Width, int i_Height)
{
	m_pWindow ? m_pWindow->resize(i_Width, i_Height) : m_pWidget->resize(i_Width, i_Height);
}

void VViewTest::SetVisible(bool i_bVisible)
{
	m_pWindow ? m_pWindow->setVisible(i_bVisible) : m_pWidget->setVisible(i_bVisible);
}

bool VViewTest::Commit()
{
	const auto isCommitted = [&]
	{
		return m_pView->MouseState() != OrlexGraphics::EMouseClicked
		    && m_pView->MouseState() != OrlexGraphics::EMouseDragged;
	};
	if (!Until(isCommitted))
		return false;
	// What was decided is posted.
	QCoreApplication::processEvents();
	return true;
}

std::vector<std::uint32_t> VViewTest::Selected() const
{
	return Indices(m_pSelection->Selection().Items());
}

std::vector<std::uint32_t> VViewTest::Preselected() const
{
	return Indices(m_pSelection->PreSelection().Items());
}
