#pragma once

#include "OrlexQtQuick/QuickWidget.h"
#include "TesselPluginInterface/ITesselExecuteCommand.h"
#include "TesselPluginRetargetSetup/FollowedFile.h"
#include "TesselPluginRetargetSetup/PanelParameters.h"

#include <QPointer>
#include <QString>
#include <QUrl>

#include <memory>
#include <optional>
#include <string>
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
	/// Where what the parameters show is not what is there, a line for each; empty where all is so.
	Q_PROPERTY(QString remarks READ Remarks NOTIFY remarksChanged)

public:
	/// No service may be null but the application, of which nothing is asked.
	VRetargetSetupWidget(std::shared_ptr<TesselPluginInterface::IQuickEngine> i_pQuickEngine,
	    std::shared_ptr<TesselPluginInterface::IDataStore> i_pDataStore,
	    std::shared_ptr<TesselPluginInterface::IParameterRegistry> i_pParameterRegistry,
	    std::shared_ptr<TesselPluginInterface::IPreferenceFolders> i_pPreferenceFolders,
	    const std::shared_ptr<TesselPluginInterface::IApplicationObject>& i_rpApplication,
	    std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher,
	    std::shared_ptr<OrlexGraphics::VSkinCache> i_pSkinCache, std::shared_ptr<VRetargetSetup> i_pRetargetSetup,
	    std::shared_ptr<VRetargetSetupSelection> i_pSelection, std::shared_ptr<VRetargetSetupScene> i_pScene,
	    QWidget* i_pParent = nullptr);
	~VRetargetSetupWidget() override;

	bool ExecuteCommand(const std::string& i_rCommand) override;

	/// Brings to the document at once what stands in the parameters, and takes over the host's selection; otherwise
	/// both are heard of through the dispatcher, some time later. A command acts on what the operator sees.
	Q_INVOKABLE void ApplyParameters();

	/// The same for what is of the present target subject: its scale and the target that is shown. Files that were
	/// chosen are for what comes next.
	Q_INVOKABLE void ApplyEdits();

	/// Whether a file stands there, or anything else of that name.
	Q_INVOKABLE bool IsThere(const QUrl& i_rFileURL) const;

	/// Below it something of the panel would be cut off.
	QSize minimumSizeHint() const override;

	const QString& Remarks() const { return m_Remarks; }

signals:
	void remarksChanged();

private:
	/// Where the mouse and the keys move the camera and the manipulator.
	void FindScene();

	void ConnectParameters();
	/// What was stored when the panel was last open.
	void ApplyStoredValues();
	void UpdateSkinFolders();
	/// As the host wants it.
	void LookForSkinsBeside(const boost::filesystem::path& i_rFile);
	void UpdateRetargetsFolder();

	void OnSourceSkeletonChanged();
	void OnTargetFBXChanged();
	/// Another program has written the file: its bones are read again, and the target subject stays.
	void OnTargetFBXWritten();
	void OnTargetRootChanged();
	void OnTargetScaleChanged();
	void OnTargetParametersChanged();
	void OnFolderPreferenceChanged(const std::string& i_rKey);
	void OnSetupChanged();
	void OnSelectionChangedShowTarget();
	void UpdateRemarks();
	void SyncScaleParameter();
	void SyncSourceSkeletonParameter();

	/// What was last heard of the parameters of the source subject, as they are written.
	struct VChosenSource
	{
		std::string m_Skeleton;
		std::string m_Skin;

		bool operator==(const VChosenSource&) const = default;
	};

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
	/// The document's number for it, and its name.
	std::uint64_t m_ShownIdentity = 0;
	std::string m_ShownName;
	std::optional<double> m_AgreedScale;
	/// The target subject that the agreed scale is of.
	std::uint64_t m_ScaledSubject = 0;
	std::optional<std::uint32_t> m_AgreedRoot;
	std::optional<std::string> m_ChosenFBX;
	/// The names of the chosen files that could not be read; empty for those that could.
	std::string m_UnreadSource;
	std::string m_UnreadFBX;
	QString m_Remarks;
	std::optional<VChosenSource> m_ChosenSource;
	std::optional<VLoadedSource> m_LoadedSource;
	/// Of FBX files that were chosen by path, the last behind.
	std::vector<boost::filesystem::path> m_OpenedFolders;
	RetargetSetup::VFollowedFile m_TargetFBXFile{[this] { OnTargetFBXWritten(); }};
};
