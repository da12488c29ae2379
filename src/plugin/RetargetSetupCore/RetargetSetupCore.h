#pragma once

#include "FBXIO/SkinSkeleton.h"
#include "NVX/Signal.h"
#include "RetargetSetupCore/BindPose.h"
#include "RetargetSetupCore/History.h"
#include "RetargetSetupCore/RetargetTargets.h"
#include "RetargetSetupCore/SessionSteps.h"
#include "RetargetSetupCore/SourceAlignment.h"
#include "RetargetSetupCore/TargetState.h"
#include "SetupProposal/Proposal.h"
#include "TesselPluginInterface/IDispatcher.h"
#include "TesselPluginInterface/IFlowFrame.h"
#include "TesselPluginInterface/IHostRules.h"
#include "TesselPluginInterface/IItemFactory.h"
#include "numerics/Matrix4.h"

#include <boost/filesystem/path.hpp>

#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace ComputeSubject
{
class VComputeSubjectFK;
}

namespace TesselPluginInterface
{
class ISelectionManager;
}

/// The document of the panel, for programs without one too: the source subject (the performer's skeleton, which is only
/// read), the target subject (the character's, which is edited and saved) and the FBX skeleton that a target subject is
/// made from.
///
/// The subjects live in six flow items, which are replaced and never changed. Every change ends in a new frame with the
/// items and one firing of the change signal. What an operation needs and does not find (a subject, an index) ends it
/// with no change. Commands return nothing: one that changed nothing says why by CommandIgnored, and what else the
/// operator ought to know goes to the log. What edits of the target subject replace is kept for Undo where a program
/// asks for it by KeepHistory. All of it runs on the user interface thread.
class VRetargetSetupCore
{
public:
	using VSubjectValues = RetargetSetup::VSubjectValues;

	VRetargetSetupCore(std::shared_ptr<TesselPluginInterface::IDispatcher> i_pDispatcher,
	    NVX::CountedPointer<TesselPluginInterface::IFrameFactory> i_pFrameFactory,
	    NVX::CountedPointer<TesselPluginInterface::IItemFactory> i_pItemFactory);
	virtual ~VRetargetSetupCore();
	VRetargetSetupCore(const VRetargetSetupCore&) = delete;
	VRetargetSetupCore& operator=(const VRetargetSetupCore&) = delete;

	/// What the host gives beyond its services; null asks nothing and has the plain form of every rule.
	void SetHostRules(std::shared_ptr<TesselPluginInterface::IHostRules> i_pRules);
	/// As the host has them now.
	TesselPluginInterface::VHostRules HostRules() const;

	/// From now on what an edit of the target subject replaces is kept, so that Undo brings it back. Making, loading
	/// and beginning anew are edits, too; a save and the source subject are not.
	/// @param i_pSelection what is selected of the document comes back through the dispatcher; null leaves it alone.
	/// @param i_MostBytes that old states may take, about; that the oldest go is told once.
	void KeepHistory(std::shared_ptr<TesselPluginInterface::ISelectionManager> i_pSelection,
	    std::size_t i_MostBytes = RetargetSetup::c_HistoryBytes);

	/// Brings back what was before the last edit, with its file and what counts as saved of it; numbers of targets come
	/// back, too.
	void Undo() { Move(true); }
	/// The other way; an edit ends that.
	void Redo() { Move(false); }

	/// What comes after is a step of its own, even if it goes on with the same drag or field.
	void EndStep();

	/// The name of what Undo and Redo would bring back or do again; empty if there is nothing.
	std::string UndoName() const { return StepName(true); }
	std::string RedoName() const { return StepName(false); }

	/// Several edits as one step, which recipes have as those of them that they know by a command of their own.
	void RunStep(const RetargetSetup::VEdit& i_rEdit, const std::function<void()>& i_rEdits);

	/// Whether the steps so far would read something else now, or read this file, which is another one by now.
	bool StepsReadAgain(const boost::filesystem::path& i_rFile) const;

	/// The steps since the target subject was made or loaded as a command line that does them again, without what was
	/// undone. Empty, and the command is ignored, where there is none or where what they began with is in no file.
	std::string SessionCommands();
	/// The same as a recipe, which gives the bytes that a save gives now. What the steps began with goes to a file
	/// beside it if it is in none any more. False, and the command is ignored, if it could not be written.
	bool SaveSessionRecipe(const boost::filesystem::path& i_rPath);

	/// Fires at the beginning of Undo and Redo: whoever is in the middle of an edit ends it there.
	NVX::VSignal<>& GetLeavingSignal() { return m_LeavingSignal; }

	/// Makes the target subject anew from the FBX skeleton, from the root bone on and with the target scale. Targets,
	/// joint edits and bind poses of the one before are lost. It is of no file.
	void CreateTargetSubject();
	/// Takes the target subject away, as it is before the first one.
	void NewTargetSubject();

	/// Ties a target segment to a source segment by the offset that they have in their bind poses: to its origin, or to
	/// its orientation. With symmetry the pair on the other side is tied too, if both sides have one. Where the host
	/// wants each pair once, a target that is there already is told by TargetFound.
	void AddTarget(int i_SourceSegmentIndex, int i_TargetSegmentIndex, bool i_bPosition, bool i_bSymmetry);
	void RemoveTarget(int i_TargetIndex);

	/// What is proposed for the source and the target subject as they stand; the joints are their segments.
	/// @return nothing if one of the two is missing or makes no tree.
	std::optional<SetupProposal::VProposal> ProposeTargets(double i_LeastScore);
	/// Adds them in one step, with their weights; one that is there already is left as it is.
	void AddTargets(const std::vector<RetargetSetup::VNewTarget>& i_rTargets);

	/// The pairs that the targets tie, for other characters. Targets that no pair can hold are told.
	/// @param o_rReason why it failed.
	bool SavePreset(const boost::filesystem::path& i_rPath, std::string& o_rReason) const;

	/// Brings the bind pose of the target subject to that of the source, and measures the offsets of all targets anew.
	/// A subject that stands as it was made takes the pose of its FBX file first.
	/// @param i_Way what several tries are one step by, see VEdit.
	/// @return how it was brought there; nothing if there is no change.
	std::optional<RetargetSetup::VAlignedToSource> AlignToSource(
	    const RetargetSetup::VAlignmentChoice& i_rChoice, std::uint64_t i_Way = 0);

	/// Each joint that there still is stands as it did when the subject was made or loaded, and not as in its FBX file.
	bool AlignsFromFilePose() const;

	/// Gives every segment a joint; those that have one keep it.
	void CreateAllJoints();

	/// Takes the joints, but for the root's, from segments that carry no target; a Ball joint's pose goes into its
	/// segment.
	void RemoveUnnecessaryJoints();
	/// The same to one segment, whether it carries a target or not.
	void RemoveJoint(std::int32_t i_SegmentIndex);

	/// Gives all segments the pose that their bones have in the FBX file, which must be the one that was read last. A
	/// subject that is made stands so at once where the host's rules want it.
	void MatchFilePose();

	/// Recalculates the offset of each target from the present bind poses.
	void UpdateTargets();

	/// True if the target subject is not what was last loaded or saved, or was made since: closing would lose it.
	bool HasUnsavedChanges() const;

	/// Read by the preview at each drag: a bind pose is mirrored to the segment on the other side.
	bool JointSymmetry() const { return m_bJointSymmetry; }
	void SetJointSymmetry(bool i_bJointSymmetry);

	/// The height of the root above the floor is scaled with the lengths: at once when this changes, and whenever the
	/// scale does.
	bool ScaleRootHeight() const { return m_Target.m_bScaleRootHeight; }
	void SetScaleRootHeight(bool i_bScale);

	/// Reads the skeleton that CreateTargetSubject uses; no subject changes. False if the file cannot be read, then the
	/// old skeleton stays, and if it has no skeleton.
	bool LoadTargetFBX(const boost::filesystem::path& i_rPath);

	/// Why the latest FBX file could not be read or has no skeleton, or where it broke off, as a sentence; empty if it
	/// is whole.
	const std::string& GetTargetFBXError() const { return m_TargetFBXError; }

	/// Stem of the FBX file that the skeleton is of.
	const std::string& GetTargetName() const { return m_TargetName; }
	/// The file itself; empty before the first.
	const boost::filesystem::path& GetTargetFBXPath() const { return m_TargetFBXFile.m_Path; }

	/// False if the latest FBX file broke off and the skeleton is what was read until then.
	bool IsTargetFBXComplete() const { return m_bTargetFBXComplete; }

	/// The segment of the target subject that stands farthest from its bone in the FBX file that was read last; nothing
	/// if all stand where their bones do, or if they are not the bones of that file.
	std::optional<RetargetSetup::VPoseDifference> DifferenceFromFile() const;

	/// Why the target subject lies or stands askew as it was made, a sentence for the operator; empty if it does not,
	/// or if its FBX file is not the one that was read last.
	const std::string& PoseNote() const { return m_PoseNote; }

	/// The segment on the other side, by the host's rule; -1 for none.
	std::int32_t PartnerOf(const VSubjectValues& i_rValues, std::size_t i_SegmentIndex) const;

	/// Index into the FBX skeleton; takes effect with the next CreateTargetSubject.
	/// @param i_bChosen false for a default, with which it is told that the file has other root bones.
	void SetTargetRootIndex(std::uint32_t i_RootIndex, bool i_bChosen = true);

	/// Takes effect on the target subject at once. Anything but a finite number above 0 is refused, and every scale for
	/// a subject whose expressions use other dynamic parameters than GlobalScale, since those go; both are told.
	void SetTargetScale(double i_Scale);

	/// The scale of the next CreateTargetSubject, with no change of the target subject that is there. What
	/// SetTargetScale refuses is ignored.
	void SetNextTargetScale(double i_Scale);
	double GetNextTargetScale() const { return m_Target.m_NextScale; }

	/// The present target subject's; 1 without one.
	double GetTargetScale() const;

	/// @param i_rSkinName goes into the application data.
	/// @return false if the file cannot be read.
	bool LoadSourceSubject(const boost::filesystem::path& i_rPath, const std::string& i_rSkinName);

	/// A file of extension ".qrx", in exactly this spelling, is a legacy text file, any other a skeleton file.
	/// @return 0; 0x80000000 for a file that cannot be read; for a legacy file also 0x8000002A if it cannot be opened
	/// and 0x80000018 if it is of a later version.
	std::uint32_t LoadTargetSubject(const boost::filesystem::path& i_rPath);

	/// Replaces the file only when the whole of it stands on disk.
	/// @return 0; 0x80000020 if it could not be written; 0x8000000A without a target subject.
	std::uint32_t SaveTargetSubject(const boost::filesystem::path& i_rPath);

	/// Writes the target subject as a save would, and leaves what counts as saved as it is.
	/// @param o_rReason why it failed.
	bool WriteCopy(const boost::filesystem::path& i_rPath, std::string& o_rReason) const;

	/// Loads a copy as unsaved work on another file.
	/// @param i_rFile empty for none. If it was written after the copy, it counts as changed by another program.
	/// @return as LoadTargetSubject.
	std::uint32_t RestoreTargetSubject(const boost::filesystem::path& i_rCopy, const boost::filesystem::path& i_rFile);

	void SetSourceSubject(
	    CoreOrlexTypes::VSubjectParametrised i_Parametrised, CoreOrlexTypes::VSubjectApplicationData i_ApplicationData);

	/// @param i_Extras of the file that the subject comes from.
	/// @param i_rEdit with commands: recipes go on with those; without, they begin with this subject.
	/// @return false, with no change, if the host made no item.
	bool SetTargetSubject(CoreOrlexTypes::VSubjectParametrised i_Parametrised,
	    CoreOrlexTypes::VSubjectApplicationData i_ApplicationData, CoreOrlexQRTIO::VSubjectQRTExtras i_Extras = {},
	    const RetargetSetup::VEdit& i_rEdit = {});

	/// An edit that leaves the application data and the extras as they are. The targets stay the ones that they are if
	/// there are as many as before.
	void SetTargetSubjectParametrised(
	    CoreOrlexTypes::VSubjectParametrised i_Parametrised, const RetargetSetup::VEdit& i_rEdit = {});

	/// The values without copies.
	VSubjectValues SourceValues() const { return RetargetSetup::ValuesOf(m_SourceItems); }
	VSubjectValues TargetValues() const { return RetargetSetup::ValuesOf(m_Target.m_Items); }

	/// What the targets are told apart by, whatever places they move to: one that is removed takes its number along. A
	/// subject that replaces another brings new ones. 0 for a target that is not there.
	std::uint64_t TargetIdentity(std::int32_t i_TargetIndex) const;
	/// Where the target stands now; -1 if it is gone.
	std::int32_t TargetOfIdentity(std::uint64_t i_Identity) const;
	/// Another one after each subject that was made, loaded or set as a whole; 0 without a target subject.
	std::uint64_t TargetSubjectIdentity() const { return m_Target.m_Identities.m_Subject; }

	/// The target subject as it was made, loaded or given the pose of its FBX file, whichever was last.
	const VSubjectValues& TargetAtRest() const { return m_Target.m_AtRest; }

	/// Copies; false, with nothing copied, if there is none.
	bool GetSourceTemplate(CoreOrlexTypes::VSubject& o_rSubject) const;
	bool GetSourceSubject(CoreOrlexTypes::VSubjectParametrised& o_rSubject) const;
	bool GetTargetTemplate(CoreOrlexTypes::VSubject& o_rSubject) const;
	bool GetTargetSubject(CoreOrlexTypes::VSubjectParametrised& o_rSubject) const;
	bool GetTargetSubjectAndData(CoreOrlexTypes::VSubjectParametrised& o_rSubject,
	    CoreOrlexTypes::VSubjectApplicationData& o_rApplicationData) const;

	/// What the target subject's file holds beyond the subject; empty for a subject that was made here.
	const CoreOrlexQRTIO::VSubjectQRTExtras& GetTargetExtras() const { return *m_Target.m_pExtras; }

	/// Stem of the source skeleton's file, or what the target subject's file tells of it.
	const std::string& GetSourceName() const { return m_SourceName; }
	/// Stem of the file that the present source subject is from, empty without one. It stays when a target subject's
	/// file tells of another source.
	const std::string& GetShownSourceName() const { return m_ShownSourceName; }

	/// Null before the first FBX file, and after one without a skeleton.
	std::shared_ptr<const FBXIO::VSkinSkeleton> GetFBXSkeleton() const { return m_pFBXSkeleton; }

	/// Turns the FBX file's space into one with Z up.
	const Rotation::VMatrix4& GetTargetAxisMatrix() const { return m_TargetAxisMatrix; }

	/// The target subject in its bind pose, with what its segments move of the skin if the FBX file that it was made of
	/// is the one that was read last. Empty without one.
	SetupProposal::VRestSkeleton TargetSkeleton() const;

	/// Fires at the end of every change, before LoadTargetSubject has taken over the source name: callbacks go through
	/// a dispatcher and read what stands when they run.
	NVX::VSignal<>& GetChangedSignal() { return m_ChangedSignal; }

	/// Null before the first change.
	NVX::CountedPointer<TesselPluginInterface::IFlowFrame> GetCurrentFrame() const { return m_pFrame; }

protected:
	/// LoadTargetSubject as a command, which asks the host before unsaved changes are lost.
	/// @param i_pCommand its name.
	/// @return whether the target subject was replaced.
	bool LoadTargetSubjectBy(const char* i_pCommand, const boost::filesystem::path& i_rPath);

	/// SaveTargetSubject as a command, which asks the host before it overwrites the change of another program. Legacy
	/// files are not written.
	/// @return whether the whole file was written.
	bool SaveTargetSubjectBy(const char* i_pCommand, const boost::filesystem::path& i_rPath);

	/// What an alignment changes.
	struct VPosedTarget
	{
		std::shared_ptr<const CoreOrlexTypes::VSubjectParametrised> m_pSubject;
		double m_NextScale = 1.0;
		bool m_bScaleRootHeight = false;
	};
	VPosedTarget PosedTarget() const;
	/// It is as it was before several tries, which are one step by the edit's way.
	void Restore(const VPosedTarget& i_rBefore, const RetargetSetup::VEdit& i_rEdit);

	// What whoever shows the document tells on. Here they do nothing.

	/// The subjects are others, and the change signal is about to fire.
	virtual void Published() {}
	virtual void JointSymmetryChanged() {}
	virtual void PoseNoteChanged() {}
	virtual void ScaleRootHeightChanged() {}
	/// With each change of the target subject and each save.
	virtual void UnsavedChangesChanged() {}
	/// After Undo and Redo.
	/// @param i_rFile that the target subject is of now, empty for none.
	virtual void TargetSubjectBroughtBack([[maybe_unused]] const boost::filesystem::path& i_rFile) {}
	/// After CreateTargetSubject.
	virtual void TargetSubjectCreated() {}
	/// AddTarget has found the target that it was to add.
	virtual void TargetFound(int /*i_TargetIndex*/) {}
	/// A command has ended with no change.
	/// @param i_pCommand its name.
	/// @param i_rReason a sentence for the operator: what was missing, or what failed.
	virtual void CommandIgnored([[maybe_unused]] const char* i_pCommand, [[maybe_unused]] const std::string& i_rReason)
	{
	}

private:
	using VSubjectItems = RetargetSetup::VSubjectItems;
	using VIdentities = RetargetSetup::VIdentities;

	/// An edit of the target subject, from where nothing of it has changed to where all has: the two are a step of the
	/// history, unless they hold the same. One within another is part of it.
	class VStep
	{
	public:
		/// @param i_bGathers its commands are those of the edits within it, if each has some.
		VStep(VRetargetSetupCore& io_rDocument, const RetargetSetup::VEdit& i_rEdit, bool i_bGathers = false);
		~VStep();
		VStep(const VStep&) = delete;
		VStep& operator=(const VStep&) = delete;

		/// What it gathers is not known to recipes.
		bool IsUnknown() const { return m_bUnknown; }

	private:
		void Begin();

		VRetargetSetupCore& m_rDocument;
		RetargetSetup::VEdit m_Edit;
		/// Null for the outermost.
		VStep* const m_pAround;
		const bool m_bGathers;
		/// An edit within it is known by no command.
		bool m_bUnknown = false;
		bool m_bGoesOn = false;
		std::optional<RetargetSetup::VTargetState> m_Before;
	};

	/// The target subject stands at the beginning of what a recipe tells.
	/// @param i_Beginning without what the document itself knows.
	void BeginSession(RetargetSetup::VBeginning i_Beginning);
	void OpenSessionStep(const RetargetSetup::VEdit& i_rEdit, const RetargetSetup::VTargetState& i_rBefore);
	/// What a recipe tells of the step that is on its way is known now.
	void CloseSessionStep();
	/// With absolute paths; nothing, and the command is ignored, without a target subject.
	std::optional<SetupIO::VSetup> SessionRecipe(const char* i_pCommand);

	void Move(bool i_bBack);
	std::string StepName(bool i_bBack) const;
	/// What is selected of the document, none without a selection manager.
	std::vector<NVX::ISelectionItem> Selected() const;
	void SelectSoon(std::vector<NVX::ISelectionItem> i_Items) const;

	/// SaveTargetSubject.
	/// @param o_rReason why it failed.
	std::uint32_t Save(const boost::filesystem::path& i_rPath, std::string& o_rReason);

	/// Asks the host before changes that are not saved are lost. False, and the command is ignored, if they stay.
	/// @param i_pAction the command in the operator's words.
	bool MayReplaceTarget(const char* i_pCommand, const char* i_pAction);

	/// False without a target subject.
	bool TargetDiffersFrom(const VSubjectValues& i_rKept) const;

	/// For a target subject that takes the place of another.
	std::shared_ptr<RetargetSetup::VTargetFile> NewFile();
	/// The target subject is of this file from now on.
	/// @param i_Saved what the file holds of it.
	void RememberTargetFile(const boost::filesystem::path& i_rPath, VSubjectValues i_Saved);
	/// Asks the host before a change of another program is overwritten.
	bool MayOverwrite(const boost::filesystem::path& i_rPath) const;

	/// Replaces the target subject at the end of a command, which is ignored if the host made no item.
	bool ReplaceTarget(const char* i_pCommand, CoreOrlexTypes::VSubjectParametrised i_Parametrised,
	    std::shared_ptr<const CoreOrlexTypes::VSubjectApplicationData> i_pApplicationData, VIdentities i_Identities);

	/// @param i_rTarget whole; its segments with joints.
	void RemoveJoints(const char* i_pCommand, const VSubjectValues& i_rTarget,
	    const std::vector<std::size_t>& i_rSegments, const RetargetSetup::VEdit& i_rEdit);

	/// Replace for the target subject.
	/// @param i_Identities of the first targets; the others are new.
	bool ReplaceTargetItems(CoreOrlexTypes::VSubjectParametrised i_Parametrised,
	    std::shared_ptr<const CoreOrlexTypes::VSubjectApplicationData> i_pApplicationData, VIdentities i_Identities);
	VIdentities NewIdentities() { return {++m_LastIdentity, {}}; }
	void TakeExtras(CoreOrlexQRTIO::VSubjectQRTExtras i_Extras);

	/// Source and target subject as they stand in their bind poses.
	struct VBothPosed
	{
		VSubjectValues m_Source;
		VSubjectValues m_Target;
		const ComputeSubject::VComputeSubjectFK* m_pSourceFK;
		std::unique_ptr<const ComputeSubject::VComputeSubjectFK> m_pTargetFK;
	};
	/// Nothing, and the command is ignored, if one of them is missing or makes no tree.
	std::optional<VBothPosed> BothPosed(const char* i_pCommand);

	/// The source subject at rest in its bind pose; null if it has none. Kept until the source subject is another one.
	const ComputeSubject::VComputeSubjectFK* SourceKinematics();

	/// Of the FBX file that was read last, the bones that the target subject's segments were made of; empty if it was
	/// made of another file.
	FBXIO::VSkinSkeleton BonesOfTarget() const;
	/// The target subject in the pose of its file.
	/// @return nothing, with the reason, where it cannot take it.
	std::optional<CoreOrlexTypes::VSubjectParametrised> InFilePose(const char*& o_rpReason) const;
	bool StandsAsMade() const;
	/// What AlignToSource makes of the target subject at its present scale, with the commands that a recipe has for it.
	/// Nothing, and the command is ignored, if nothing can be aligned.
	struct VAlignedEdit
	{
		RetargetSetup::VAligned m_Aligned;
		RetargetSetup::VEdit m_Edit;
	};
	std::optional<VAlignedEdit> Aligned(const RetargetSetup::VAlignmentChoice& i_rChoice);
	void UpdatePoseNote();
	/// What the root's height is multiplied by at a scale.
	double RootFactor(double i_Scale) const { return ScaleRootHeight() ? i_Scale : 1.0; }

	/// Replaces the items of one subject and publishes.
	/// @param i_pApplicationData null keeps the item that is there.
	/// @return false, with no change, if the host made no item.
	bool Replace(VSubjectItems& io_rItems, std::shared_ptr<const CoreOrlexTypes::VSubjectParametrised> i_pParametrised,
	    std::shared_ptr<const CoreOrlexTypes::VSubjectApplicationData> i_pApplicationData);
	void Publish();

	template <typename T>
	NVX::CountedPointer<TesselPluginInterface::IFlowItem> MakeItem(
	    const VSubjectItems& i_rItems, const char* i_pFlowType, std::shared_ptr<const T> i_pValue);

	const std::shared_ptr<TesselPluginInterface::IDispatcher> m_pDispatcher;
	const NVX::CountedPointer<TesselPluginInterface::IFrameFactory> m_pFrameFactory;
	const NVX::CountedPointer<TesselPluginInterface::IItemFactory> m_pItemFactory;
	std::shared_ptr<TesselPluginInterface::IHostRules> m_pHostRules;
	std::shared_ptr<const FBXIO::VSkinSkeleton> m_pFBXSkeleton;
	RetargetSetup::VReadFile m_TargetFBXFile;
	RetargetSetup::VReadFile m_SourceFile;
	std::string m_TargetName;
	std::string m_TargetFBXError;
	std::string m_SourceName;
	std::string m_ShownSourceName;
	std::string m_PoseNote;
	VSubjectItems m_SourceItems;
	RetargetSetup::VTargetState m_Target;
	NVX::CountedPointer<TesselPluginInterface::IFlowFrame> m_pFrame;
	Rotation::VMatrix4 m_TargetAxisMatrix;
	std::uint32_t m_TargetRootIndex = 0;
	bool m_bJointSymmetry = true;
	NVX::VSignal<> m_ChangedSignal;

	/// Of the target subject and of those that Undo and Redo bring back.
	std::vector<std::weak_ptr<RetargetSetup::VTargetFile>> m_Files;
	/// Nothing where no history is kept.
	std::optional<RetargetSetup::VHistory> m_History;
	std::shared_ptr<TesselPluginInterface::ISelectionManager> m_pSelection;
	NVX::VSignal<> m_LeavingSignal;
	/// Within a step.
	/// The innermost that is on its way.
	VStep* m_pStep = nullptr;
	bool m_bForgotTold = false;

	std::unique_ptr<const ComputeSubject::VComputeSubjectFK> m_pSourceFK;
	std::shared_ptr<const CoreOrlexTypes::VSubject> m_pSubjectOfSourceFK;
	std::uint64_t m_LastIdentity = 0;
	bool m_bTargetFBXComplete = true;
	/// The root bone was chosen since the FBX file was read.
	bool m_bTargetRootChosen = false;
};
