#include "TestPanel.h"

#include "../FindItem.h"
#include "OrlexGraphics/item/SceneFramebufferObject.h"
#include "RetargetSetupCore/Identity.h"

#include <QtQml>

VPanelTest::~VPanelTest()
{
	EXPECT_TRUE(!m_pGui || m_pGui->m_pEngine->m_Warnings.isEmpty())
	    << m_pGui->m_pEngine->m_Warnings.join('\n').toStdString();
	m_pWidget.reset();
	m_pScene.reset();
	m_pSelection.reset();
	m_pDocument.reset();
	Run();
	m_pGui.reset();
}

void VPanelTest::Open(bool i_bModules)
{
	qmlRegisterType<OrlexGraphics::VSceneFramebufferObject>(
	    "TesselPluginRetargetSetup", 1, 0, "SceneFramebufferObject");
	m_pWidget.reset();
	m_pGui = std::make_unique<VTestGui>(m_Context, i_bModules);
	m_pDocument = std::make_shared<VRetargetSetup>(
	    m_Context.GetDispatcher(), m_Context.GetFrameFactory(), m_Context.GetItemFactory());
	m_pSelection = NVX::MakeShared<VRetargetSetupSelection>(m_Context.GetDispatcher(), m_Context.GetSelectionManager());
	m_pScene = NVX::MakeShared<VRetargetSetupScene>(m_pGui->GetGraphicsContext(), m_Context.GetDispatcher(),
	    m_Context.GetSelectionManager(), m_pGui->GetSkinCache(), m_pDocument, m_Context.GetItemFactory(), false);
	m_pWidget = std::make_unique<VRetargetSetupWidget>(m_pGui->GetQuickEngine(), m_Context.GetDataStore(),
	    m_Context.GetParameterRegistry(), m_Context.GetPreferenceFolders(), m_Context.GetApplicationObject(),
	    m_Context.GetDispatcher(), m_pGui->GetSkinCache(), m_pDocument, m_pSelection, m_pScene);
	Run();
}

QQuickItem* VPanelTest::Item(const QString& i_rObjectName) const
{
	QQuickItem* const pItem = m_pWidget->rootObject() ? FindItem(m_pWidget->rootObject(), i_rObjectName) : nullptr;
	EXPECT_TRUE(pItem) << i_rObjectName.toStdString();
	return pItem;
}

QVariant VPanelTest::Property(const QString& i_rObjectName, const char* i_pProperty) const
{
	const QQuickItem* const pItem = Item(i_rObjectName);
	return pItem ? pItem->property(i_pProperty) : QVariant();
}

TesselPluginInterface::IParameter& VPanelTest::Parameter(const std::string& i_rKey) const
{
	for (const char* const pGroup : {"Subject", "Target"})
		if (const auto pParameter = m_Context.m_pRegistry->Find("RetargetSetup", pGroup)->Find(i_rKey))
			return *pParameter;
	throw std::runtime_error("no parameter " + i_rKey);
}

std::string VPanelTest::Type(const std::string& i_rKey, const std::string& i_rText)
{
	std::string refused = Parameter(i_rKey).SetValueText(i_rText);
	Run();
	return refused;
}

void VPanelTest::Select(std::uint32_t i_Kind, std::uint32_t i_Index)
{
	auto& rSelection = m_Context.SelectionManager().Selection();
	rSelection.Remove(rSelection.ItemsOfKind(i_Kind));
	rSelection.Add({{i_Kind, RetargetSetup::c_SubjectId, i_Index, {}}});
	Run();
}

CoreOrlexTypes::VSubjectParametrised VPanelTest::Target() const
{
	CoreOrlexTypes::VSubjectParametrised subject;
	EXPECT_TRUE(m_pDocument->GetTargetSubject(subject));
	return subject;
}

void VPanelTest::OpenDemo()
{
	m_Context.Folders().SetFolder("FolderSubjects", RETARGET_SOURCE "/demo");
	m_Context.Folders().SetFolder("FolderSkins", RETARGET_SOURCE "/demo");
	Open();
	EXPECT_EQ(Type("SourceSkeleton", "performer"), "");
	EXPECT_EQ(Type("TargetFBX", "character"), "");
}
