#pragma once

#include "RetargetSetupCore/RetargetSetupCore.h"
#include "RetargetSetupDocument/RetargetSetupSegmentModel.h"
#include "RetargetSetupDocument/RetargetSetupTargetModel.h"

#include <QMatrix4x4>
#include <QObject>
#include <QUrl>
#include <QVariant>

#include <memory>
#include <thread>
#include <vector>

namespace SetupProposal
{
struct VPoseFinding;
}

/// The document as QML sees it: the properties, signals and list models of what VRetargetSetupCore keeps and does. A
/// command that changed nothing says why by commandIgnored.
class VRetargetSetup : public QObject, public VRetargetSetupCore
{
	Q_OBJECT
	/// Read by the preview at each drag: a bind pose is mirrored to the segment on the other side.
	Q_PROPERTY(bool jointSymmetry READ JointSymmetry WRITE SetJointSymmetry NOTIFY jointSymmetryChanged)
	/// Read by whoever marks the file's name.
	Q_PROPERTY(bool unsavedChanges READ HasUnsavedChanges NOTIFY unsavedChangesChanged)
	Q_PROPERTY(bool scaleRootHeight READ ScaleRootHeight WRITE SetScaleRootHeight NOTIFY scaleRootHeightChanged)
	/// A sentence for the operator, or empty.
	Q_PROPERTY(QString poseNote READ PoseNote NOTIFY poseNoteChanged)

public:
	VRetargetSetup(std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher,
	    NVX::CountedPointer<TesselPluginInterface::IFrameFactory> i_pFrameFactory,
	    NVX::CountedPointer<TesselPluginInterface::IItemFactory> i_pItemFactory);
	~VRetargetSetup() override;

	// The core's commands, for QML.

	Q_INVOKABLE void CreateTargetSubject() { VRetargetSetupCore::CreateTargetSubject(); }
	Q_INVOKABLE void NewTargetSubject() { VRetargetSetupCore::NewTargetSubject(); }
	Q_INVOKABLE void LoadTargetSubjectURL(const QUrl& i_rFileURL);
	Q_INVOKABLE void SaveTargetSubjectURL(const QUrl& i_rFileURL);
	Q_INVOKABLE void AddTarget(int i_SourceSegmentIndex, int i_TargetSegmentIndex, bool i_bPosition, bool i_bSymmetry)
	{
		VRetargetSetupCore::AddTarget(i_SourceSegmentIndex, i_TargetSegmentIndex, i_bPosition, i_bSymmetry);
	}
	Q_INVOKABLE void RemoveTarget(int i_TargetIndex) { VRetargetSetupCore::RemoveTarget(i_TargetIndex); }
	Q_INVOKABLE void CreateAllJoints() { VRetargetSetupCore::CreateAllJoints(); }
	Q_INVOKABLE void RemoveUnnecessaryJoints() { VRetargetSetupCore::RemoveUnnecessaryJoints(); }
	Q_INVOKABLE void RemoveJoint(int i_SegmentIndex) { VRetargetSetupCore::RemoveJoint(i_SegmentIndex); }
	Q_INVOKABLE void MatchFilePose() { VRetargetSetupCore::MatchFilePose(); }
	Q_INVOKABLE void UpdateTargets() { VRetargetSetupCore::UpdateTargets(); }
	Q_INVOKABLE bool HasUnsavedChanges() const { return VRetargetSetupCore::HasUnsavedChanges(); }

	// For a host that offers the tools beyond the panel. Segments go by index, pairs of them are maps: "source",
	// "target", "score", "reasons", the weights "position" and "rotation" of the targets that the pair should get, and
	// "present" for a pair that has them.

	/// Lists of maps: "pairs", "alternatives", "unmapped" of the source with "reason"; and "findings", sentences on how
	/// the two stand; and "noBody", why nothing is proposed where one of the two is no body. Empty if nothing can be
	/// proposed, which commandIgnored tells.
	Q_INVOKABLE QVariantMap ProposeTargets(double i_LeastScore);
	/// The pairs of a preset as they fit these two, by names and by what is proposed: as ProposeTargets gives pairs,
	/// "score" left out, with "misfits", sentences on pairs that do not fit, in place of findings. Empty if there are
	/// none, which commandIgnored tells.
	Q_INVOKABLE QVariantMap FitPreset(const QUrl& i_rFileURL, double i_LeastScore);
	/// The pairs of the target subject. False, with the reason told by commandIgnored, if it could not be written.
	Q_INVOKABLE bool SavePresetURL(const QUrl& i_rFileURL);
	/// @param i_rTargets maps of "source", "target", "position" (else it is one of rotation) and "weight".
	Q_INVOKABLE void AddTargets(const QVariantList& i_rTargets);

	/// Brings the target subject to the pose of the source, beginning anew with the pose that stood there before the
	/// first of several calls; all of them are one step.
	/// @param i_rChains which are wanted: spine, arms, legs, others.
	/// @param i_rLocked segments of the target subject whose joints stay.
	/// @param i_bFitScale scales it first, with the height of its root, so that its hips come to stand as high as the
	/// source's, where they do not.
	/// @param i_bFeetWithShins feet lean as the shins do; else they keep their tilt.
	/// @return "joints", a list of maps: "target", "source", "before", "after" in degrees, "note"; "turn" in degrees,
	/// "move" and "lift" in mm, "refused", a list of sentences; "scale", what would fit or does, 1 where there is
	/// nothing to fit, "scaled", and "heights", a sentence on hips. Empty if there is no change, which commandIgnored
	/// tells.
	Q_INVOKABLE QVariantMap AlignToSource(
	    const QVariantList& i_rChains, const QVariantList& i_rLocked, bool i_bFitScale, bool i_bFeetWithShins);
	/// What it has made is still there.
	Q_INVOKABLE bool IsAligning() const;
	/// @param i_bKeep false: the pose before it comes back, unless the target subject has become another one since.
	Q_INVOKABLE void EndAlignment(bool i_bKeep);

	/// What would become of the target subject with the FBX file that was read last, or with the source as another
	/// performer.
	/// @return "refusal", a sentence, or "lost", "changed" and "added", lists of sentences and names, "renamed", a list
	/// of sentences on what was found under another name, and "kept", how many were found under their own. Empty if all
	/// is as it was, or there are no two to hold against each other.
	Q_INVOKABLE QVariantMap LookAtRebind(bool i_bPerformer) const;
	/// Does it, in one step.
	/// @param i_bMeasure measures the offsets of all targets anew, too.
	Q_INVOKABLE void Rebind(bool i_bPerformer, bool i_bMeasure);

	// What can be told of the target subject, as a map of "summary", a sentence, and "rows", a list of maps: "cells",
	// texts in the order that stands with each, and "about", a text that names segments and targets as messages do.
	// Empty if there is nothing to tell, for the reason that commandIgnored tells.

	/// In what it differs from a file, which is the earlier one. Cells: a sentence.
	Q_INVOKABLE QVariantMap CompareWith(const QUrl& i_rFileURL);
	/// Which joints could go, and which targets pull against each other while the source goes through its range. The
	/// skin is that of the FBX file that was read last, if the target subject was made of it. Cells: joint or target,
	/// verdict, what the bind pose would be without the joint, why. Rows of joints have "joint", the segment's index.
	/// It is found out on a thread beside, and told by advised; what is asked for last counts.
	/// @return false, with the reason told by commandIgnored, if there is nothing to tell.
	Q_INVOKABLE bool Advise();
	/// How source and target subject differ as they stand at rest. Cells: what, "fine" or "look", a sentence with the
	/// numbers, what mends it.
	Q_INVOKABLE QVariantMap CheckPose();

	// For a host that offers Undo and Redo.

	Q_INVOKABLE void Undo() { VRetargetSetupCore::Undo(); }
	Q_INVOKABLE void Redo() { VRetargetSetupCore::Redo(); }
	Q_INVOKABLE QString UndoName() const { return QString::fromStdString(VRetargetSetupCore::UndoName()); }
	Q_INVOKABLE QString RedoName() const { return QString::fromStdString(VRetargetSetupCore::RedoName()); }
	Q_INVOKABLE void EndStep() { VRetargetSetupCore::EndStep(); }

	/// A command line for a shell; empty, which commandIgnored tells, if there is none.
	Q_INVOKABLE QString SessionCommands() { return QString::fromStdString(VRetargetSetupCore::SessionCommands()); }
	/// False, with the reason told by commandIgnored, if it could not be written.
	Q_INVOKABLE bool SaveRecipeURL(const QUrl& i_rFileURL);

	/// For a host that keeps what is unsaved. False, with the reason told in the log, if it could not be written.
	Q_INVOKABLE bool WriteCopyURL(const QUrl& i_rFileURL) const;
	/// What was kept is unsaved work on the file again, which may be empty.
	/// @return false, with the reason told by commandIgnored, if it could not be read.
	Q_INVOKABLE bool RestoreTargetSubjectURL(const QUrl& i_rCopyURL, const QUrl& i_rFileURL);

	QString PoseNote() const;

	std::shared_ptr<VRetargetSetupSegmentModel> GetSourceSegmentModel() const { return m_pSourceSegmentModel; }
	std::shared_ptr<VRetargetSetupSegmentModel> GetTargetSegmentModel() const { return m_pTargetSegmentModel; }
	std::shared_ptr<VRetargetSetupTargetModel> GetTargetModel() const { return m_pTargetModel; }

signals:
	void jointSymmetryChanged();
	void poseNoteChanged();
	void scaleRootHeightChanged();

	/// With each change of the target subject and each save.
	void unsavedChangesChanged();

	/// After LoadTargetSubjectURL has replaced the target subject, and never for a file that could not be loaded.
	void targetSubjectLoaded(const QUrl& i_rFileURL);

	/// After SaveTargetSubjectURL has written the whole file.
	void targetSubjectSaved(const QUrl& i_rFileURL);

	/// After CreateTargetSubject.
	void targetSubjectCreated();

	/// Another program has written the FBX file anew, and it was read again with other bones; or another source was
	/// chosen.
	void rebindCalledFor(bool i_bPerformer);

	/// After Undo and Redo.
	/// @param i_rFileURL of the target subject that is there now; empty if it is of no file.
	void targetSubjectBroughtBack(const QUrl& i_rFileURL);

	/// AddTarget has found the target that it was to add.
	void targetFound(int i_TargetIndex);

	/// What Advise has found out, of the subjects as they stood then.
	void advised(const QVariantMap& i_rReview);

	/// A command has ended with no change.
	/// @param i_rCommand the name of the invokable.
	/// @param i_rReason a sentence for the operator: what was missing, or what failed.
	void commandIgnored(const QString& i_rCommand, const QString& i_rReason);

private:
	/// Fresh list models.
	void Published() override;
	void JointSymmetryChanged() override { emit jointSymmetryChanged(); }
	void PoseNoteChanged() override { emit poseNoteChanged(); }
	void ScaleRootHeightChanged() override { emit scaleRootHeightChanged(); }
	void UnsavedChangesChanged() override { emit unsavedChangesChanged(); }
	void TargetSubjectCreated() override { emit targetSubjectCreated(); }
	void TargetFound(int i_TargetIndex) override { emit targetFound(i_TargetIndex); }
	void TargetSubjectBroughtBack(const boost::filesystem::path& i_rFile) override;
	void CommandIgnored(const char* i_pCommand, const std::string& i_rReason) override;

	std::vector<SetupProposal::VPoseFinding> PoseFindings(const SetupProposal::VProposal& i_rProposal) const;

	/// Empty, and the command is ignored, if the URL is not of a local file.
	boost::filesystem::path LocalPath(const char* i_pCommand, const QUrl& i_rFileURL);

	/// Before and after what AlignToSource has done; null without it.
	VPosedTarget m_BeforeAlignment;
	std::shared_ptr<const CoreOrlexTypes::VSubjectParametrised> m_pAligned;
	std::uint64_t m_Alignment = 0;
	const std::shared_ptr<VRetargetSetupSegmentModel> m_pSourceSegmentModel;
	const std::shared_ptr<VRetargetSetupSegmentModel> m_pTargetSegmentModel;
	const std::shared_ptr<VRetargetSetupTargetModel> m_pTargetModel;
	/// Set by nothing and read by nothing, as is the spare flag.
	QMatrix4x4 m_SpareMatrix;
	[[maybe_unused]] bool m_bSpare = false;
	bool m_bAdvising = false;
	/// It was asked once more since.
	bool m_bAdviseAgain = false;
	/// Last: it uses others.
	std::jthread m_Advising;
};
