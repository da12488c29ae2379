#include "TesselPluginRetargetSetup/RetargetSetupWidget.h"

#include "OrlexGraphics/item/SceneFramebufferObject.h"
#include "OrlexGraphics/skins/SkinCache.h"
#include "OrlexQtQuick/GuardedCallback.h"
#include "RetargetSetupDocument/RetargetSetup.h"
#include "RetargetSetupDocument/RetargetSetupSelection.h"
#include "TesselParameters/Parameter.h"
#include "TesselParametersGUI/ParameterFBX.h"
#include "TesselPluginInterface/IPreferenceFolders.h"
#include "TesselPluginInterface/PathTypes.h"
#include "TesselPluginRetargetSetup/RetargetSetupScene.h"
#include "UtilsFileSystem/InstalledProducts.h"
#include "UtilsFileSystem/Paths.h"

#include <QFileInfo>
#include <QQuickItem>
#include <QVBoxLayout>

using OrlexQtQuick::Guarded;
using TesselPluginInterface::c_FolderKeys;

namespace
{

/// A step of the manipulator's size up, and the same step down.
constexpr double c_ManipulatorScaleUp = 1.35;
constexpr double c_ManipulatorScaleDown = 0.7407407;
/// Each of them is watched.
constexpr std::size_t c_MostOpenedFolders = 4;

} // namespace

static void InitialiseResources()
{
	Q_INIT_RESOURCE(RetargetSetup);
}

VRetargetSetupWidget::VRetargetSetupWidget(std::shared_ptr<TesselPluginInterface::IQuickEngine> i_pQuickEngine,
    std::shared_ptr<TesselPluginInterface::IDataStore> i_pDataStore,
    std::shared_ptr<TesselPluginInterface::IParameterRegistry> i_pParameterRegistry,
    std::shared_ptr<TesselPluginInterface::IPreferenceFolders> i_pPreferenceFolders,
    const std::shared_ptr<TesselPluginInterface::IApplicationObject>& /*i_rpApplication*/,
    std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher,
    std::shared_ptr<OrlexGraphics::VSkinCache> i_pSkinCache, std::shared_ptr<VRetargetSetup> i_pRetargetSetup,
    std::shared_ptr<VRetargetSetupSelection> i_pSelection, std::shared_ptr<VRetargetSetupScene> i_pScene,
    QWidget* i_pParent)
    : VQuickWidget(std::move(i_pQuickEngine), i_pParent), m_pDataStore(std::move(i_pDataStore)),
      m_pParameterRegistry(std::move(i_pParameterRegistry)), m_pPreferenceFolders(std::move(i_pPreferenceFolders)),
      m_pDispatcher(std::move(i_pDispatcher)), m_pSkinCache(std::move(i_pSkinCache)),
      m_Installed(RetargetSetup::InstalledFolders([this](const std::string& i_rProduct)
          { return UtilsFileSystem::FindInstallLocation(i_rProduct, *m_pPreferenceFolders); })),
      m_Parameters(m_pDataStore, *m_pParameterRegistry, *m_pPreferenceFolders, m_Installed),
      m_pRetargetSetup(std::move(i_pRetargetSetup)), m_pSelection(std::move(i_pSelection)),
      m_pScene(std::move(i_pScene)), m_bOwnSkinFolders(!m_pSkinCache->HasFolders(OrlexGraphics::c_pSubjectSkins)),
      m_ShownTarget(m_Parameters.ReadTarget(-1))
{
	InitialiseResources();
	UpdateSkinFolders();
	ConnectParameters();

	setContextProperty("FlowScene", m_pScene.get());
	setContextProperty("FocusSelection", QVariant(false));
	setContextProperty("MouseOver", QVariant(true));
	setContextProperty("ContextRetargetSetup", m_pRetargetSetup.get());
	setContextProperty("RetargetSetupSelection", m_pSelection.get());
	setContextProperty("SourceSegmentModel", m_pRetargetSetup->GetSourceSegmentModel().get());
	setContextProperty("TargetSegmentModel", m_pRetargetSetup->GetTargetSegmentModel().get());
	setContextProperty("TargetModel", m_pRetargetSetup->GetTargetModel().get());
	UpdateRetargetsFolder();

	setLayout(new QVBoxLayout);
	connect(this, &QQuickWidget::statusChanged, this, &VRetargetSetupWidget::FindScene);
	Load(QStringLiteral(RETARGET_SETUP_QML), QStringLiteral("RetargetSetup.qml"));
	setResizeMode(SizeRootObjectToView);

	connect(m_pSelection.get(), &VRetargetSetupSelection::Changed, this,
	    &VRetargetSetupWidget::OnSelectionChangedShowTarget);
	connect(m_pRetargetSetup.get(), &VRetargetSetup::targetFound, m_pSelection.get(),
	    &VRetargetSetupSelection::SelectTarget);
	m_pRetargetSetup->GetChangedSignal().Connect(Guarded(this, &VRetargetSetupWidget::OnSetupChanged), m_pDispatcher);
	ApplyStoredValues();
}

VRetargetSetupWidget::~VRetargetSetupWidget()
{
	for (NVX::VConnection& rConnection : m_Connections)
		rConnection.Disconnect();
	// What the QML shows ends with the members.
	ReleaseContent();
}

void VRetargetSetupWidget::FindScene()
{
	m_pSceneItem = rootObject() ? rootObject()->findChild<OrlexGraphics::VSceneFramebufferObject*>() : nullptr;
	if (m_pSceneItem)
		m_pSceneItem->SetWheelInFixedViews(m_pRetargetSetup->HostRules().m_bWheelInFixedViews);
}

bool VRetargetSetupWidget::IsThere(const QUrl& i_rFileURL) const
{
	return QFileInfo::exists(i_rFileURL.toLocalFile());
}

QSize VRetargetSetupWidget::minimumSizeHint() const
{
	const QQuickItem* const pRoot = rootObject();
	return pRoot ? QSize(pRoot->property("minimumWidth").toInt(), pRoot->property("minimumHeight").toInt()) : QSize();
}

bool VRetargetSetupWidget::ExecuteCommand(const std::string& i_rCommand)
{
	const auto scaleManipulator = [this](double i_Factor)
	{
		if (m_pSceneItem)
			m_pSceneItem->ScaleManipulator(i_Factor);
		return true;
	};
	if (i_rCommand == "Workspace3d:ScaleUpManipulator")
		return scaleManipulator(c_ManipulatorScaleUp);
	if (i_rCommand == "Workspace3d:ScaleDownManipulator")
		return scaleManipulator(c_ManipulatorScaleDown);
	if (i_rCommand != "Workspace3d:FrameSelected")
		return false;
	setContextProperty("FocusSelection", QVariant(true));
	return true;
}

void VRetargetSetupWidget::UpdateSkinFolders()
{
	if (!m_bOwnSkinFolders)
		return;
	std::vector<boost::filesystem::path> folders = m_Installed.m_Skins;
	const boost::filesystem::path user = m_pPreferenceFolders->Folder(c_FolderKeys[TesselPluginInterface::EPathSkins]);
	if (!user.empty())
		folders.push_back(user);
	// Of several the last counts: what was chosen last.
	for (const boost::filesystem::path& rFolder : m_OpenedFolders)
	{
		std::erase(folders, rFolder);
		folders.push_back(rFolder);
	}
	m_pSkinCache->SetFolders(OrlexGraphics::c_pSubjectSkins, folders);
}

void VRetargetSetupWidget::LookForSkinsBeside(const boost::filesystem::path& i_rFile)
{
	if (!m_pRetargetSetup->HostRules().m_bSkinBesideFile)
		return;
	std::erase(m_OpenedFolders, i_rFile.parent_path());
	m_OpenedFolders.push_back(i_rFile.parent_path());
	if (m_OpenedFolders.size() > c_MostOpenedFolders)
		m_OpenedFolders.erase(m_OpenedFolders.begin());
	UpdateSkinFolders();
}

void VRetargetSetupWidget::UpdateRetargetsFolder()
{
	const boost::filesystem::path folder =
	    m_pPreferenceFolders->Folder(c_FolderKeys[TesselPluginInterface::EPathRetargets]);
	setContextProperty(
	    "ContextRetargetsUrl", QVariant(QUrl::fromLocalFile(QString::fromStdString(UtilsFileSystem::ToUtf8(folder)))));
}

#include "moc_RetargetSetupWidget.cpp"
