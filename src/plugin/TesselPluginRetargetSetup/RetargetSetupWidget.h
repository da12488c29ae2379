#pragma once

#include "OrlexQtQuick/QuickWidget.h"
#include "TesselPluginInterface/ITesselExecuteCommand.h"
#include "TesselPluginRetargetSetup/PanelParameters.h"

#include <QPointer>

#include <memory>
#include <optional>
#include <vector>

class VRetargetSetup;
class VRetargetSetupScene;
class VRetargetSetupSelection;

namespace OrlexGraphics
{
class VSceneFramebufferObject;
class VSkinCache;
} // namespace OrlexGraphics

namespace TesselPluginInterface
{
class IApplicationObject;
class IDispatcher;
} // namespace TesselPluginInterface

/// The panel: shows the document and its scene in QML, brings what the operator sets in the parameters to the document
/// and what the document has to the parameters, and answers the host's commands. User interface thread only.
///
/// Parameters and document follow each other without an echo: the panel keeps what the two last agreed on, and a side
/// passes on only what differs from that.
class VRetargetSetupWidget : public OrlexQtQuick::VQuickWidget, public ITesselExecuteCommand
{
	Q_OBJECT

public:
	/// No service may be null but the application, of which nothing is asked.
	VRetargetSetupWidget(std::shared_ptr<TesselPluginInterface::IQuickEngine> i_pQuickEngine,
	    std::shared_ptr<TesselPluginInterface::IDataStore> i_pDataStore,
	    std::shared_ptr<TesselPluginInterface::IParameterRegistry> i_pParameterRegistry,
	    std::shared_ptr<TesselPluginInterface::IPreferenceFolders> i_pPreferenceFolders,
	    std::shared_ptr<TesselPluginInterface::IApplicationObject> i_pApplication,
	    std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher,
	    std::shared_ptr<OrlexGraphics::VSkinCache> i_pSkinCache, std::shared_ptr<VRetargetSetup> i_pRetargetSetup,
	    std::shared_ptr<VRetargetSetupSelection> i_pSelection, std::shared_ptr<VRetargetSetupScene> i_pScene,
	    QWidget* i_pParent = nullptr);
	~VRetargetSetupWidget() override;

	bool ExecuteCommand(const std::string& i_rCommand) override;

	/// Brings to the document at once the scale and the target's values that stand in the parameters; otherwise it
	/// hears of it through the dispatcher.
	Q_INVOKABLE void ApplyParameters();

	/// Below it something of the panel would be cut off.
	QSize minimumSizeHint() const override;

private:
	/// Where the mouse and the keys move the camera and the manipulator.
	void FindScene();

	void ConnectParameters();
	/// What was stored when the panel was last open.
	void ApplyStoredValues();
	void UpdateSkinFolders();
	void UpdateRetargetsFolder();

	void OnSourceSkeletonChanged();
	void OnTargetFBXChanged();
	void OnTargetRootChanged();
	void OnTargetScaleChanged();
	void OnTargetParametersChanged();
	void OnFolderPreferenceChanged(const std::string& i_rKey);
	void OnSetupChanged();
	void OnSelectionChangedShowTarget();
	void SyncScaleParameter();
	void SyncSourceSkeletonParameter();

	/// A file that the source subject was made of.
	struct VLoadedSource
	{
		boost::filesystem::path m_Path;
		std::string m_SkinName;

		bool operator==(const VLoadedSource&) const = default;
	};

	/// Null until the QML stands.
	QPointer<OrlexGraphics::VSceneFramebufferObject> m_pSceneItem;
	const std::shared_ptr<TesselPluginInterface::IDataStore> m_pDataStore;
	const std::shared_ptr<TesselPluginInterface::IParameterRegistry> m_pParameterRegistry;
	const std::shared_ptr<TesselPluginInterface::IPreferenceFolders> m_pPreferenceFolders;
	const std::shared_ptr<TesselPluginInterface::IDispatcher> m_pDispatcher;
	const std::shared_ptr<OrlexGraphics::VSkinCache> m_pSkinCache;
	const RetargetSetup::VProductFolders m_Installed;
	RetargetSetup::VPanelParameters m_Parameters;
	const std::shared_ptr<VRetargetSetup> m_pRetargetSetup;
	const std::shared_ptr<VRetargetSetupSelection> m_pSelection;
	const std::shared_ptr<VRetargetSetupScene> m_pScene;

	/// To signals of the host, which outlive the panel and may not fire for long.
	std::vector<NVX::VConnection> m_Connections;

	/// Nobody else has given the skin cache folders.
	const bool m_bOwnSkinFolders;
	RetargetSetup::VShownTarget m_ShownTarget;
	std::optional<double> m_AgreedScale;
	std::optional<VLoadedSource> m_LoadedSource;
};
