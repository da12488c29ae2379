#pragma once

#include "retarget/subject/Elements.h"
#include "retarget/text/Output.h"

#include "InMemoryHost/Application.h"
#include "InMemoryHost/Dispatcher.h"
#include "RetargetSetupCore/RetargetSetupCore.h"
#include "RetargetSetupCore/SourceAlignment.h"
#include "SetupProposal/Proposal.h"
#include "numerics/Rotation.h"

#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace CommandLine
{

/// The document with host services in memory. Operations throw VCommandError to fail.
class VSession
{
public:
	VSession();

	/// EBadInput if the file cannot be read. Tells if the target subject was made for another source.
	void LoadSource(const std::string& i_rPath);
	void LoadTarget(const std::string& i_rPath);

	/// Reads the FBX file, whole or with EBadInput.
	void LoadFbx(const std::string& i_rPath);
	/// Reads the FBX file and makes the target subject of it, from the root bone of this name or index on; without one
	/// the choice is the document's. EWrongUsage for a root that the file does not have.
	/// @param i_bBodyRoot without a name, the root bone that most of the body hangs on, which needs a source.
	void CreateTarget(const std::string& i_rPath, const std::optional<std::string>& i_rRoot, bool i_bBodyRoot = false,
	    const std::string& i_rRootWhere = {});

	/// EBadOutput if the file could not be written; the one that stood there then stays. "-" is standard output.
	/// EFindings with --strict, and nothing written, if there has been a warning or saving would bring one.
	void Save(const std::string& i_rPath);

	/// A subject that was made of standard input holds no name of that file: to be called before it is saved, since the
	/// document knows the file by a name until then.
	void ForgetNamelessFiles();

	/// With --json where the subject was saved and what it holds; what edits have to tell, unless the subject itself
	/// went to standard output.
	void Report(const std::string& i_rPath) const;

	VRetargetSetupCore& Document() { return *m_pDocument; }
	const std::shared_ptr<VRetargetSetupCore>& SharedDocument() const { return m_pDocument; }
	const std::shared_ptr<InMemoryHost::VDispatcher>& Dispatcher() const { return m_pDispatcher; }

	/// Runs what the document has posted.
	void Settle() { m_pDispatcher->RunPending(); }

	/// EWrongUsage, with what the source is needed for, if there is none.
	const CoreOrlexTypes::VSubjectParametrised& Source(const std::string& i_rWhatFor) const;
	const CoreOrlexTypes::VSubjectParametrised& Target() const;

	/// Segments of the target subject that have a joint.
	std::size_t CountJoints() const;

	/// False for one from standard input.
	bool IsSourceNamed() const { return m_bSourceNamed; }

	/// Why the command that did nothing last did nothing, a sentence.
	const std::string& WhyIgnored() const { return m_WhyIgnored; }

	/// Gives all bind poses of the file.
	void MatchFilePose();
	/// What was told of the pose before is forgotten.
	void TookFilePose();

	/// Saved as the source that the subject is made for.
	void NameSource(const std::string& i_rName);

	/// Whether targets that are added get a mirrored partner; off at first, as in the panel.
	bool m_bSymmetry = false;
	/// Segments that are each other's partner whatever their names say, by index; the last one counts.
	using VPartners = std::vector<std::pair<std::size_t, std::size_t>>;
	VPartners m_SourcePartners;
	VPartners m_TargetPartners;
	/// One sentence for each target of a side that should have got a partner and did not.
	std::vector<std::string> m_WithoutPartner;
	bool m_bAllowPartial = false;
	/// What re-binding could not keep, a sentence each.
	std::vector<std::string> m_Lost;
	/// Of pairs that are proposed.
	double m_MinimumScore = SetupProposal::c_DefaultLeastScore;
	/// The bone that the target subject was made from; nothing for one that was loaded.
	std::optional<std::size_t> m_Root;
	/// The bind poses have been taken from the file.
	bool m_bMatched = false;
	/// What an alignment reaches.
	RetargetSetup::VAlignmentChoice m_Alignment;
	bool m_bAligned = false;
	/// An alignment scales a target subject that has the size of its file to the source's, where they differ.
	bool m_bFitsScale = false;
	/// Offsets that --auto has measured are measured again at each scale, as long as nobody has given one.
	bool m_bOffsetsFollowScale = false;
	/// What edits add to the report.
	VJson m_ReportJson = VJson::object();
	std::string m_ReportText;

private:
	std::shared_ptr<InMemoryHost::VApplication> m_pApplication;
	std::shared_ptr<InMemoryHost::VDispatcher> m_pDispatcher;
	std::string m_WhyIgnored;
	std::shared_ptr<VRetargetSetupCore> m_pDocument;
	/// False where it came from standard input.
	bool m_bSourceNamed = true;
	bool m_bTargetNamed = true;
};

/// The bone of this name, with its namespace or without, or of this index. EWrongUsage if the file does not have it.
std::size_t FindRootBone(const std::string& i_rWord, const FBXIO::VSkinSkeleton& i_rSkeleton);

/// World poses of all segments of a subject in its bind pose, in mm; empty, which is told, if it has no
/// kinematics.
std::vector<Rotation::VPose<double>> BindPosesOf(
    const VRetargetSetupCore::VSubjectValues& i_rValues, const char* i_pWhich);

} // namespace CommandLine
