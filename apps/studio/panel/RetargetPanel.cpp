#include "studio/panel/RetargetPanel.h"

#include "DebugServices/GlobalLog.h"
#include "NVX/IQuickWidget.h"
#include "OrlexGraphics/item/Tracking.h"
#include "TesselDataStore/StoredValue.h"
#include "TesselPluginInterface/IParameter.h"
#include "TesselPluginInterface/IParameterGroup.h"
#include "TesselPluginInterface/IParameterRegistry.h"
#include "studio/host/UnsavedWork.h"
#include "studio/panel/FileKind.h"
#include "studio/window/PlainTexts.h"

#include <QAbstractItemModel>
#include <QAction>
#include <QFileInfo>
#include <QQmlComponent>
#include <QQuickItem>
#include <QQuickWidget>
#include <QQuickWindow>
#include <QRegularExpression>

#include <algorithm>
#include <utility>

namespace StudioHost
{
namespace
{

constexpr const char* c_pDocument = "ContextRetargetSetup";
constexpr const char* c_pParameterPath = "RetargetSetup";
constexpr const char* c_pParameterGroup = "Subject";
constexpr const char* c_pCurrentFile = "currentTargetSubjectURL";
constexpr const char* c_pSource = "SourceSkeleton";
constexpr const char* c_pFbx = "TargetFBX";

/// What the operator pressed, by the document's command.
constexpr std::pair<const char*, const char*> c_Buttons[] = {{"CreateTargetSubject", "Create Target Subject"},
    {"LoadTargetSubjectURL", "Load"}, {"SaveTargetSubjectURL", "Save"}, {"AddTarget", "Add target"},
    {"RemoveTarget", "Remove target"}, {"CreateAllJoints", "Create all joints"}, {"RemoveJoint", "Remove Joint"},
    {"RemoveUnnecessaryJoints", "Remove unnecessary joints"}, {"MatchFilePose", "Take pose from FBX"},
    {"UpdateTargets", "Update targets"}, {"ProposeTargets", "Propose Targets"}, {"AddTargets", "Propose Targets"},
    {"AlignToSource", "Align to Source"}, {"CopyCommands", "Copy as Commands"}, {"SaveRecipe", "Save as Recipe"},
    {"FitPreset", "Preset"}, {"Rebind", "Re-bind"}, {"SavePreset", "Save as Preset"}, {"CompareWith", "Compare"},
    {"Advise", "Advice"}, {"CheckPose", "Check Pose"}, {"RestoreTargetSubjectURL", "Restore"}};

/// By objectName, of what can be seen.
QQuickItem* ItemNamed(QQuickItem& i_rItem, const QString& i_rName)
{
	if (!i_rItem.isVisible())
		return nullptr;
	if (i_rItem.objectName() == i_rName)
		return &i_rItem;
	for (QQuickItem* pChild : i_rItem.childItems())
		if (QQuickItem* const pFound = ItemNamed(*pChild, i_rName))
			return pFound;
	return nullptr;
}

} // namespace

std::unique_ptr<VRetargetPanel> VRetargetPanel::Find(
    QWidget& i_rPanel, std::shared_ptr<TesselPluginInterface::IParameterRegistry> i_pParameters)
{
	auto* const pQuick = qobject_cast<NVX::IQuickWidget*>(&i_rPanel);
	QObject* const pDocument = pQuick ? pQuick->contextProperty(QLatin1String(c_pDocument)).value<QObject*>() : nullptr;
	if (!pDocument)
		return nullptr;
	return std::unique_ptr<VRetargetPanel>(new VRetargetPanel(i_rPanel, *pDocument, std::move(i_pParameters)));
}

VRetargetPanel::VRetargetPanel(
    QWidget& i_rPanel, QObject& i_rDocument, std::shared_ptr<TesselPluginInterface::IParameterRegistry> i_pParameters)
    : m_pWidget(&i_rPanel), m_pDocument(&i_rDocument), m_pParameters(std::move(i_pParameters))
{
	connect(m_pDocument, SIGNAL(commandIgnored(QString, QString)), this, SLOT(TellIgnored(QString, QString)));
	connect(m_pDocument, SIGNAL(targetSubjectLoaded(QUrl)), this, SLOT(TellUsed(QUrl)));
	connect(m_pDocument, SIGNAL(targetSubjectSaved(QUrl)), this, SLOT(TellUsed(QUrl)));
	connect(m_pDocument, SIGNAL(unsavedChangesChanged()), this, SIGNAL(stateChanged()));
	connect(m_pDocument, SIGNAL(advised(QVariantMap)), this, SIGNAL(advised(QVariantMap)));
	connect(m_pDocument, SIGNAL(rebindCalledFor(bool)), this, SIGNAL(rebindCalledFor(bool)));
	for (const char* const pName : {"SourceSegmentModel", "TargetSegmentModel"})
		if (const QAbstractItemModel* const pModel = Model(pName))
			connect(pModel, &QAbstractItemModel::modelReset, this, &VRetargetPanel::segmentsChanged);
	if (auto* const pQuickWidget = qobject_cast<QQuickWidget*>(m_pWidget.data()))
		connect(pQuickWidget, &QQuickWidget::statusChanged, this, &VRetargetPanel::FollowRootItem);
	FollowRootItem();
}

void VRetargetPanel::FollowSelected(bool i_bFollow)
{
	if (QQuickItem* const pView = Item("scene"))
		pView->setProperty("tracking",
		    QVariant::fromValue(i_bFollow ? OrlexGraphics::ETrackingSelectionThen : OrlexGraphics::ETrackingNone));
}

bool VRetargetPanel::ViewHasKeyboard() const
{
	const QQuickItem* const pView = Item("scene");
	return pView && pView->hasActiveFocus();
}

bool VRetargetPanel::IsReady() const
{
	return m_pRoot;
}

void VRetargetPanel::FollowRootItem()
{
	const auto* const pQuickWidget = qobject_cast<QQuickWidget*>(m_pWidget.data());
	QObject* const pRoot = pQuickWidget ? pQuickWidget->rootObject() : nullptr;
	if (!pRoot || pRoot == m_pRoot)
		return;
	m_pRoot = pRoot;
	if (pRoot->metaObject()->indexOfProperty(c_pCurrentFile) >= 0)
		connect(pRoot, SIGNAL(currentTargetSubjectURLChanged()), this, SIGNAL(stateChanged()));
	MakeStartPage();
	emit ready();
}

bool VRetargetPanel::Open(const QString& i_rPath)
{
	const QFileInfo file(i_rPath);
	const QString path = file.absoluteFilePath();
	const EFileKind kind = KindOf(path);
	if (kind == EFileKind::EOther || kind == EFileKind::ETake)
	{
		NVX_LOG("Import", NVX::ELogError, "%1% is of no kind that can be opened: %2%", path.toStdString(),
		    AllExtensions().toStdString());
		return false;
	}
	if (!file.isFile() || !file.isReadable())
	{
		NVX_LOG("Import", NVX::ELogError, "%1% %2%", path.toStdString(),
		    file.exists() ? "is no file that can be read" : "does not exist");
		return false;
	}
	switch (kind)
	{
	case EFileKind::ESource: return SetParameter(c_pSource, path);
	case EFileKind::EFbx: return SetParameter(c_pFbx, path);
	default:
		ApplyTyped();
		return QMetaObject::invokeMethod(
		    m_pDocument, "LoadTargetSubjectURL", Qt::DirectConnection, Q_ARG(QUrl, QUrl::fromLocalFile(path)));
	}
}

QRectF VRetargetPanel::PlaceOf(EFileKind i_Kind) const
{
	const char* const pName = i_Kind == EFileKind::ESource ? c_pSource
	    : i_Kind == EFileKind::EFbx                        ? c_pFbx
	    : i_Kind == EFileKind::ETarget                     ? "currentFile"
	                                                       : nullptr;
	const QQuickItem* const pItem = pName ? Item(pName) : nullptr;
	return pItem ? pItem->mapRectToScene(pItem->boundingRect()) : QRectF();
}

void VRetargetPanel::MarkDrop(const QStringList& i_rPaths)
{
	m_pDropMark.reset();
	auto* const pQuickWidget = qobject_cast<QQuickWidget*>(m_pWidget.data());
	if (i_rPaths.isEmpty() || !pQuickWidget || !m_pRoot)
		return;
	QStringList lines;
	QVariantList places;
	for (const QString& rPath : i_rPaths)
	{
		const EFileKind kind = KindOf(rPath);
		const QString name = ShownFileName(rPath);
		lines << (kind == EFileKind::EOther ? tr("%1 cannot be opened").arg(name)
		                                    : tr("%1 opens as the %2").arg(name, KindName(kind)));
		if (const QRectF place = PlaceOf(kind); !place.isEmpty())
			places << place;
	}
	m_pDropMark = MakeOverlay("DropMark.qml",
	    {{"parent", QVariant::fromValue(pQuickWidget->quickWindow()->contentItem())}, {"text", lines.join('\n')},
	        {"places", places}});
}

std::unique_ptr<QObject> VRetargetPanel::MakeOverlay(const char* i_pFile, const QVariantMap& i_rProperties) const
{
	// The panel lies over all widgets of the window, so what lies over the panel is part of its scene.
	QQmlComponent component(static_cast<QQuickWidget*>(m_pWidget.data())->engine(),
	    QStringLiteral("qrc:/qml/Orlex/Controls/") + QLatin1String(i_pFile), QQmlComponent::PreferSynchronous);
	return std::unique_ptr<QObject>(component.createWithInitialProperties(i_rProperties));
}

QQuickItem* VRetargetPanel::Item(const char* i_pName) const
{
	auto* const pRoot = qobject_cast<QQuickItem*>(m_pRoot.data());
	return pRoot ? ItemNamed(*pRoot, QLatin1String(i_pName)) : nullptr;
}

void VRetargetPanel::OfferToBegin(const QList<QAction*>& i_rActions)
{
	m_StartActions = i_rActions;
	MakeStartPage();
}

void VRetargetPanel::MakeStartPage()
{
	m_pStartPage.reset();
	QQuickItem* const pView = Item("scene");
	if (!pView || m_StartActions.isEmpty())
		return;
	QStringList texts;
	for (const QAction* const pAction : m_StartActions)
		texts << pAction->text().remove('&');
	m_pStartPage =
	    MakeOverlay("StartPage.qml", {{"parent", QVariant::fromValue(pView->parentItem())}, {"texts", texts}});
	connect(m_pStartPage.get(), SIGNAL(chosen(int)), this, SLOT(Begin(int)), Qt::QueuedConnection);
	connect(this, &VRetargetPanel::segmentsChanged, this, &VRetargetPanel::UpdateStartPage, Qt::UniqueConnection);
	UpdateStartPage();
}

void VRetargetPanel::Begin(int i_Index)
{
	m_StartActions.value(i_Index)->trigger();
}

void VRetargetPanel::UpdateStartPage()
{
	const auto isEmpty = [this](const char* i_pName)
	{
		const QAbstractItemModel* const pModel = Model(i_pName);
		return !pModel || pModel->rowCount() == 0;
	};
	if (m_pStartPage)
		m_pStartPage->setProperty(
		    "visible", !m_bViewInUse && isEmpty("SourceSegmentModel") && isEmpty("TargetSegmentModel"));
}

void VRetargetPanel::SetViewInUse(bool i_bInUse)
{
	m_bViewInUse = i_bInUse;
	UpdateStartPage();
}

void VRetargetPanel::FocusFirstField()
{
	if (QQuickItem* const pField = Item(c_pSource))
	{
		m_pWidget->setFocus();
		pField->forceActiveFocus();
	}
}

std::shared_ptr<TesselPluginInterface::IParameter> VRetargetPanel::Parameter(const char* i_pName) const
{
	const auto pGroup = m_pParameters->Find(c_pParameterPath, c_pParameterGroup);
	return pGroup ? pGroup->Find(i_pName) : nullptr;
}

bool VRetargetPanel::SetParameter(const char* i_pName, const QString& i_rPath)
{
	const auto pParameter = Parameter(i_pName);
	if (!pParameter)
	{
		NVX_LOG("Import", NVX::ELogError, "%1% cannot be opened: the panel has no parameter %2%", i_rPath.toStdString(),
		    i_pName);
		return false;
	}
	// The panel offers a file from outside its folders by itself.
	pParameter->SetValue(TesselDataStore::ToVariant(i_rPath.toStdString()));
	emit fileUsed(i_rPath);
	return true;
}

const QAbstractItemModel* VRetargetPanel::Model(const char* i_pName) const
{
	const auto* const pPanel = qobject_cast<NVX::IQuickWidget*>(m_pWidget.data());
	return pPanel ? qobject_cast<QAbstractItemModel*>(pPanel->contextProperty(QLatin1String(i_pName)).value<QObject*>())
	              : nullptr;
}

QString VRetargetPanel::CurrentFile() const
{
	return m_pRoot ? m_pRoot->property(c_pCurrentFile).toUrl().toLocalFile() : QString();
}

bool VRetargetPanel::IsCurrentFileReadOnly() const
{
	return CurrentFile().endsWith(QStringLiteral(".qrx"));
}

QString VRetargetPanel::WhyNotSave() const
{
	const QAbstractItemModel* const pSegments = Model("TargetSegmentModel");
	return pSegments && pSegments->rowCount() > 0 ? QString() : tr("there is no target subject yet");
}

void VRetargetPanel::New()
{
	ApplyTyped();
	QMetaObject::invokeMethod(m_pDocument, "NewTargetSubject");
}

void VRetargetPanel::Undo()
{
	ApplyTyped();
	QMetaObject::invokeMethod(m_pDocument, "Undo");
}

void VRetargetPanel::Redo()
{
	ApplyTyped();
	QMetaObject::invokeMethod(m_pDocument, "Redo");
}

QString VRetargetPanel::UndoName() const
{
	return AskDocument("UndoName");
}

QString VRetargetPanel::RedoName() const
{
	return AskDocument("RedoName");
}

QString VRetargetPanel::AskDocument(const char* i_pQuestion) const
{
	QString answer;
	QMetaObject::invokeMethod(m_pDocument, i_pQuestion, Qt::DirectConnection, Q_RETURN_ARG(QString, answer));
	return answer;
}

void VRetargetPanel::EndStep()
{
	QMetaObject::invokeMethod(m_pDocument, "EndStep");
}

QString VRetargetPanel::SessionCommands()
{
	ApplyTyped();
	return AskDocument("SessionCommands");
}

bool VRetargetPanel::SaveRecipe(const QString& i_rPath)
{
	return SaveBy("SaveRecipeURL", i_rPath);
}

QVariantMap VRetargetPanel::ProposeTargets(double i_LeastScore)
{
	ApplyTyped();
	QVariantMap proposal;
	QMetaObject::invokeMethod(m_pDocument, "ProposeTargets", Qt::DirectConnection, Q_RETURN_ARG(QVariantMap, proposal),
	    Q_ARG(double, i_LeastScore));
	return proposal;
}

QVariantMap VRetargetPanel::FitPreset(const QString& i_rPath, double i_LeastScore)
{
	ApplyTyped();
	QVariantMap fit;
	QMetaObject::invokeMethod(m_pDocument, "FitPreset", Qt::DirectConnection, Q_RETURN_ARG(QVariantMap, fit),
	    Q_ARG(QUrl, QUrl::fromLocalFile(i_rPath)), Q_ARG(double, i_LeastScore));
	return fit;
}

bool VRetargetPanel::SavePreset(const QString& i_rPath)
{
	return SaveBy("SavePresetURL", i_rPath);
}

bool VRetargetPanel::SaveBy(const char* i_pCommand, const QString& i_rPath)
{
	ApplyTyped();
	bool bSaved = false;
	QMetaObject::invokeMethod(m_pDocument, i_pCommand, Qt::DirectConnection, Q_RETURN_ARG(bool, bSaved),
	    Q_ARG(QUrl, QUrl::fromLocalFile(i_rPath)));
	return bSaved;
}

void VRetargetPanel::AddTargets(const QVariantList& i_rTargets)
{
	ApplyTyped();
	QMetaObject::invokeMethod(m_pDocument, "AddTargets", Q_ARG(QVariantList, i_rTargets));
}

QVariantMap VRetargetPanel::AlignToSource(
    const QVariantList& i_rChains, const QVariantList& i_rLocked, bool i_bFitScale, bool i_bFeetWithShins)
{
	ApplyTyped();
	QVariantMap aligned;
	QMetaObject::invokeMethod(m_pDocument, "AlignToSource", Qt::DirectConnection, Q_RETURN_ARG(QVariantMap, aligned),
	    Q_ARG(QVariantList, i_rChains), Q_ARG(QVariantList, i_rLocked), Q_ARG(bool, i_bFitScale),
	    Q_ARG(bool, i_bFeetWithShins));
	return aligned;
}

bool VRetargetPanel::IsAligning() const
{
	bool bAligning = false;
	QMetaObject::invokeMethod(m_pDocument, "IsAligning", Qt::DirectConnection, Q_RETURN_ARG(bool, bAligning));
	return bAligning;
}

void VRetargetPanel::EndAlignment(bool i_bKeep)
{
	QMetaObject::invokeMethod(m_pDocument, "EndAlignment", Q_ARG(bool, i_bKeep));
}

QVariantMap VRetargetPanel::LookAtRebind(bool i_bPerformer) const
{
	QVariantMap look;
	QMetaObject::invokeMethod(
	    m_pDocument, "LookAtRebind", Qt::DirectConnection, Q_RETURN_ARG(QVariantMap, look), Q_ARG(bool, i_bPerformer));
	return look;
}

void VRetargetPanel::Rebind(bool i_bPerformer, bool i_bMeasure)
{
	ApplyTyped();
	QMetaObject::invokeMethod(m_pDocument, "Rebind", Q_ARG(bool, i_bPerformer), Q_ARG(bool, i_bMeasure));
}

QVariantMap VRetargetPanel::CompareWith(const QString& i_rPath)
{
	ApplyTyped();
	QVariantMap review;
	QMetaObject::invokeMethod(m_pDocument, "CompareWith", Qt::DirectConnection, Q_RETURN_ARG(QVariantMap, review),
	    Q_ARG(QUrl, QUrl::fromLocalFile(i_rPath)));
	return review;
}

bool VRetargetPanel::Advise()
{
	ApplyTyped();
	bool bAsked = false;
	QMetaObject::invokeMethod(m_pDocument, "Advise", Qt::DirectConnection, Q_RETURN_ARG(bool, bAsked));
	return bAsked;
}

void VRetargetPanel::RemoveJoint(int i_Segment)
{
	ApplyTyped();
	QMetaObject::invokeMethod(m_pDocument, "RemoveJoint", Qt::DirectConnection, Q_ARG(int, i_Segment));
}

QVariantMap VRetargetPanel::Review(const char* i_pQuestion)
{
	ApplyTyped();
	QVariantMap review;
	QMetaObject::invokeMethod(m_pDocument, i_pQuestion, Qt::DirectConnection, Q_RETURN_ARG(QVariantMap, review));
	return review;
}

QStringList VRetargetPanel::SegmentsOf(const char* i_pModel) const
{
	const QAbstractItemModel* const pModel = Model(i_pModel);
	QStringList names;
	for (int row = 0; pModel && row < pModel->rowCount(); ++row)
		names << pModel->index(row, 0).data(pModel->roleNames().key("name")).toString();
	return names;
}

std::vector<NVX::ISelectionItem> VRetargetPanel::SegmentItems(int i_Source, int i_Target) const
{
	std::vector<NVX::ISelectionItem> items;
	for (const auto& [pName, row] : {std::pair("SourceSegmentModel", i_Source), {"TargetSegmentModel", i_Target}})
		if (const QAbstractItemModel* const pModel = Model(pName); pModel && row >= 0 && row < pModel->rowCount())
			items.push_back(
			    pModel->index(row, 0).data(pModel->roleNames().key("selectionItem")).value<NVX::ISelectionItem>());
	return items;
}

void VRetargetPanel::SaveAs()
{
	QObject* const pDialog = m_pRoot ? m_pRoot->findChild<QObject*>(QStringLiteral("saveDialog")) : nullptr;
	if (!WhyNotSave().isEmpty())
		TellIgnored(QStringLiteral("SaveTargetSubjectURL"), tr("There is no target subject yet."));
	else if (pDialog)
		QMetaObject::invokeMethod(pDialog, "open");
}

void VRetargetPanel::Save()
{
	// Without a file the panel asks for one.
	if (!CurrentFile().isEmpty())
		QMetaObject::invokeMethod(m_pRoot, "save");
	else
		SaveAs();
}

void VRetargetPanel::SaveTo(const QString& i_rPath)
{
	ApplyTyped();
	QMetaObject::invokeMethod(
	    m_pDocument, "SaveTargetSubjectURL", Qt::DirectConnection, Q_ARG(QUrl, QUrl::fromLocalFile(i_rPath)));
}

void VRetargetPanel::ApplyTyped()
{
	if (m_pRoot)
		QMetaObject::invokeMethod(m_pRoot, "commitEdits");
}

bool VRetargetPanel::HasUnsavedChanges() const
{
	bool bUnsaved = false;
	QMetaObject::invokeMethod(m_pDocument, "HasUnsavedChanges", Qt::DirectConnection, Q_RETURN_ARG(bool, bUnsaved));
	return bUnsaved;
}

bool VRetargetPanel::WriteCopy(const QString& i_rPath) const
{
	bool bWritten = false;
	QMetaObject::invokeMethod(m_pDocument, "WriteCopyURL", Qt::DirectConnection, Q_RETURN_ARG(bool, bWritten),
	    Q_ARG(QUrl, QUrl::fromLocalFile(i_rPath)));
	return bWritten;
}

VUnsavedWork VRetargetPanel::Work() const
{
	const auto text = [this](const char* i_pName)
	{
		const auto pParameter = Parameter(i_pName);
		return pParameter ? QString::fromStdString(pParameter->GetValueText()) : QString();
	};
	const QAbstractItemModel* const pTargets = Model("TargetModel");
	VUnsavedWork work;
	work.m_File = CurrentFile();
	work.m_Source = text(c_pSource);
	work.m_Fbx = text(c_pFbx);
	work.m_Targets = pTargets ? pTargets->rowCount() : 0;
	return work;
}

bool VRetargetPanel::Restore(const VUnsavedWork& i_rWork)
{
	bool bRestored = false;
	QMetaObject::invokeMethod(m_pDocument, "RestoreTargetSubjectURL", Qt::DirectConnection,
	    Q_RETURN_ARG(bool, bRestored), Q_ARG(QUrl, QUrl::fromLocalFile(i_rWork.m_Copy)),
	    Q_ARG(QUrl, i_rWork.m_File.isEmpty() ? QUrl() : QUrl::fromLocalFile(i_rWork.m_File)));
	return bRestored;
}

std::vector<NVX::ISelectionItem> VRetargetPanel::ItemsNamedIn(const QString& i_rMessage) const
{
	// Names stand in quotes, targets by their number.
	static const QRegularExpression s_Name(QStringLiteral("'([^']+)'|\"([^\"]+)\""));
	static const QRegularExpression s_Target(QStringLiteral("\\b[Tt]arget #?(\\d+)"));
	// As the models show them.
	const QString message = ShownText(i_rMessage);
	QStringList names;
	for (auto match = s_Name.globalMatch(message); match.hasNext();)
		names << match.next().capturedTexts().last();
	const QRegularExpressionMatch target = s_Target.match(message);

	std::vector<NVX::ISelectionItem> items;
	const auto take = [&](const char* i_pModel, const auto& i_IsNamed)
	{
		const QAbstractItemModel* const pModel = Model(i_pModel);
		if (!pModel)
			return;
		const QHash<int, QByteArray> roles = pModel->roleNames();
		for (int row = 0; row < pModel->rowCount(); ++row)
		{
			const QModelIndex index = pModel->index(row, 0);
			if (i_IsNamed(row, index.data(roles.key("name")).toString()))
				items.push_back(index.data(roles.key("selectionItem")).value<NVX::ISelectionItem>());
		}
	};
	const auto isSegment = [&](int, const QString& i_rName) { return names.contains(i_rName); };
	take("SourceSegmentModel", isSegment);
	take("TargetSegmentModel", isSegment);
	take("TargetModel",
	    [&](int i_Row, const QString& i_rName)
	    { return (target.hasMatch() && i_Row == target.captured(1).toInt()) || names.contains(i_rName); });
	return items;
}

void VRetargetPanel::TellIgnored(const QString& i_rCommand, const QString& i_rReason)
{
	const auto found =
	    std::ranges::find(c_Buttons, i_rCommand, [](const auto& i_rRow) { return QString(i_rRow.first); });
	const QString name = found == std::end(c_Buttons) ? i_rCommand : found->second;
	NVX_LOG("Command", NVX::ELogWarning, "%1%: %2%", name.toStdString(), i_rReason.toStdString());
	if (i_rCommand == QStringLiteral("SaveTargetSubjectURL"))
		emit saveFailed(i_rReason);
}

void VRetargetPanel::TellUsed(const QUrl& i_rUrl)
{
	emit fileUsed(i_rUrl.toLocalFile());
}

} // namespace StudioHost

#include "moc_RetargetPanel.cpp"
