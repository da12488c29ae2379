#pragma once

#include "NVX/SelectionItemVariant.h"

#include <QList>
#include <QObject>
#include <QPointer>
#include <QRectF>
#include <QString>
#include <QUrl>
#include <QVariant>

#include <memory>
#include <vector>

class QAbstractItemModel;
class QAction;
class QQuickItem;
class QWidget;

namespace TesselPluginInterface
{
class IParameter;
class IParameterRegistry;
} // namespace TesselPluginInterface

namespace StudioHost
{

enum class EFileKind;
struct VUnsavedWork;

/// The "Retarget Setup" panel as far as this program knows it: by the names that it shows to its QML and the names of
/// its parameters, not by its classes.
class VRetargetPanel : public QObject
{
	Q_OBJECT

public:
	/// Nothing if the widget is no such panel.
	static std::unique_ptr<VRetargetPanel> Find(
	    QWidget& i_rPanel, std::shared_ptr<TesselPluginInterface::IParameterRegistry> i_pParameters);

	/// Opens a file by its kind, as the panel's own controls would. Why a file is not opened is told in the log.
	/// @return false if it was not even tried.
	bool Open(const QString& i_rPath);

	/// Shows over the panel what files are opened as, and at which of its fields. Nothing for an empty list.
	void MarkDrop(const QStringList& i_rPaths);

	/// A view without subjects shows a button for each of these; the last one is for what the lists of files offer.
	/// They must outlive the panel.
	void OfferToBegin(const QList<QAction*>& i_rActions);
	/// The buttons give way to something that is shown without subjects.
	void SetViewInUse(bool i_bInUse);

	/// The keyboard goes to what a job begins with.
	void FocusFirstField();

	/// Saves the target subject to its file; the panel asks for one if there is none.
	void Save();
	void SaveTo(const QString& i_rPath);

	/// What is being typed reaches the target subject.
	void ApplyTyped();

	/// The panel asks for the file.
	void SaveAs();

	/// Begins without a target subject and without a file; performer and character stay.
	void New();

	/// What is being typed is an edit, too.
	void Undo();
	void Redo();
	/// Of the edit that it would be; empty if there is none.
	QString UndoName() const;
	QString RedoName() const;
	/// The next edit is a step of its own, even of the same field.
	void EndStep();

	/// The steps since the target subject was made or loaded, as commands of the command line; empty if there are none,
	/// which is told.
	QString SessionCommands();
	/// False, with the reason told, if it could not be written.
	bool SaveRecipe(const QString& i_rPath);

	/// What the document proposes, see its function of this name; empty if it proposes nothing, which is told.
	QVariantMap ProposeTargets(double i_LeastScore);
	/// The document's function of this name.
	QVariantMap FitPreset(const QString& i_rPath, double i_LeastScore);
	/// False, with the reason told, if it could not be written.
	bool SavePreset(const QString& i_rPath);
	/// In one step.
	void AddTargets(const QVariantList& i_rTargets);
	// The document's functions of these names.
	QVariantMap AlignToSource(
	    const QVariantList& i_rChains, const QVariantList& i_rLocked, bool i_bFitScale, bool i_bFeetWithShins);
	bool IsAligning() const;
	void EndAlignment(bool i_bKeep);
	QVariantMap LookAtRebind(bool i_bPerformer) const;
	void Rebind(bool i_bPerformer, bool i_bMeasure);
	// The document's functions of these names.
	QVariantMap CompareWith(const QString& i_rPath);
	/// The answer comes by advised. False, with the reason told, if there is none to come.
	bool Advise();
	/// Of a segment of the character.
	void RemoveJoint(int i_Segment);
	QVariantMap CheckPose() { return Review("CheckPose"); }
	/// By name.
	QStringList SourceSegments() const { return SegmentsOf("SourceSegmentModel"); }
	QStringList TargetSegments() const { return SegmentsOf("TargetSegmentModel"); }
	/// Of a segment of the performer and one of the character, for the selection; -1 for none.
	std::vector<NVX::ISelectionItem> SegmentItems(int i_Source, int i_Target) const;

	/// Empty if there is a target subject.
	QString WhyNotSave() const;

	/// The target subject would be lost. What is being typed does not count.
	bool HasUnsavedChanges() const;

	/// Writes what "Save" would write, and leaves what counts as saved as it is.
	bool WriteCopy(const QString& i_rPath) const;
	/// What the target subject is done with now: its file, performer and character, and how many targets it has.
	VUnsavedWork Work() const;
	/// A copy becomes unsaved work on its file again. False, with the reason told in the log, if it cannot be read.
	bool Restore(const VUnsavedWork& i_rWork);

	/// The segments and the target that a message names, for the selection.
	std::vector<NVX::ISelectionItem> ItemsNamedIn(const QString& i_rMessage) const;

	/// What "Save" writes; empty without a file.
	QString CurrentFile() const;
	/// The current file is one that is only read.
	bool IsCurrentFileReadOnly() const;

	QWidget* Widget() const { return m_pWidget; }

	/// The middle of the preview goes along with what is selected now, as a take plays; or it stays.
	void FollowSelected(bool i_bFollow);

	/// Keys go to the preview.
	bool ViewHasKeyboard() const;

	/// The panel's QML has been loaded.
	bool IsReady() const;

signals:
	/// A file was opened, or the target subject saved to it.
	void fileUsed(const QString& i_rPath);

	/// Why a save ended with no file.
	void saveFailed(const QString& i_rReason);

	/// The current file is another one, or what is unsaved has changed.
	void stateChanged();

	/// The character's file has other bones, or another performer was chosen.
	void rebindCalledFor(bool i_bPerformer);

	/// The document's signal of this name.
	void advised(const QVariantMap& i_rReview);

	/// The segments of performer or character may be others.
	void segmentsChanged();

	void ready();

private:
	VRetargetPanel(QWidget& i_rPanel, QObject& i_rDocument,
	    std::shared_ptr<TesselPluginInterface::IParameterRegistry> i_pParameters);

	QString AskDocument(const char* i_pQuestion) const;
	QVariantMap Review(const char* i_pQuestion);
	bool SaveBy(const char* i_pCommand, const QString& i_rPath);
	std::shared_ptr<TesselPluginInterface::IParameter> Parameter(const char* i_pName) const;
	bool SetParameter(const char* i_pName, const QString& i_rPath);
	void FollowRootItem();
	void MakeStartPage();
	/// An item of its QML that can be seen, by objectName; null if there is none.
	QQuickItem* Item(const char* i_pName) const;
	std::unique_ptr<QObject> MakeOverlay(const char* i_pFile, const QVariantMap& i_rProperties) const;
	QStringList SegmentsOf(const char* i_pModel) const;
	/// A list that the panel shows to its QML; null if there is none.
	const QAbstractItemModel* Model(const char* i_pName) const;
	/// Where a file of this kind stands, in pixels of the panel; empty for nowhere.
	QRectF PlaceOf(EFileKind i_Kind) const;

private slots:
	void Begin(int i_Index);
	void UpdateStartPage();
	void TellIgnored(const QString& i_rCommand, const QString& i_rReason);
	void TellUsed(const QUrl& i_rUrl);

private:
	const QPointer<QWidget> m_pWidget;
	const QPointer<QObject> m_pDocument;
	const std::shared_ptr<TesselPluginInterface::IParameterRegistry> m_pParameters;
	QPointer<QObject> m_pRoot;
	std::unique_ptr<QObject> m_pDropMark;
	QList<QAction*> m_StartActions;
	std::unique_ptr<QObject> m_pStartPage;
	bool m_bViewInUse = false;
};

} // namespace StudioHost
