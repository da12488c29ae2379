#pragma once

#include "CoreOrlexQRTIO/SubjectQRTExtras.h"
#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectApplicationData.h"
#include "CoreOrlexTypes/SubjectParametrised.h"
#include "NVX/ISelectionItem.h"
#include "TesselPluginInterface/IItemFactory.h"

#include <boost/filesystem/path.hpp>

#include <cstddef>
#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace RetargetSetup
{

/// A subject in its three forms. Null what there is not; shared, and never changed.
struct VSubjectValues
{
	std::shared_ptr<const CoreOrlexTypes::VSubject> m_pSubject;
	std::shared_ptr<const CoreOrlexTypes::VSubjectApplicationData> m_pApplicationData;
	std::shared_ptr<const CoreOrlexTypes::VSubjectParametrised> m_pParametrised;
};

/// The flow items that carry them.
struct VSubjectItems
{
	NVX::CountedPointer<TesselPluginInterface::IFlowItem> m_pSubject;
	NVX::CountedPointer<TesselPluginInterface::IFlowItem> m_pApplicationData;
	NVX::CountedPointer<TesselPluginInterface::IFlowItem> m_pParametrised;
};

VSubjectValues ValuesOf(const VSubjectItems& i_rItems);

/// Numbers that tell a subject and its targets from all others.
struct VIdentities
{
	std::uint64_t m_Subject = 0;
	std::vector<std::uint64_t> m_Targets;
};

/// The file of a target subject that was made, loaded or begun anew. All later states of that subject share it, so that
/// a save counts for them, too.
struct VTargetFile
{
	/// Empty for no file.
	boost::filesystem::path m_Path;
	/// Of what the file held when it was last loaded or saved; none for no file.
	std::optional<std::string> m_Digest;
	/// What the file held then.
	VSubjectValues m_Saved;
	/// As it was made from an FBX file.
	VSubjectValues m_Made;
};

struct VSessionStep;

/// All of the document that an edit of the target subject may change. A copy shares the values with it.
struct VTargetState
{
	VSubjectItems m_Items;
	/// Never null.
	std::shared_ptr<const CoreOrlexQRTIO::VSubjectQRTExtras> m_pExtras =
	    std::make_shared<const CoreOrlexQRTIO::VSubjectQRTExtras>();
	/// The target subject as it was made, loaded or given the pose of its FBX file, whichever was last.
	VSubjectValues m_AtRest;
	VIdentities m_Identities;
	/// Never null in the document.
	std::shared_ptr<VTargetFile> m_pFile;
	/// Of the next subject that is made.
	double m_NextScale = 1.0;
	bool m_bScaleRootHeight = false;
	/// What led here; null without a target subject, and where no history is kept.
	std::shared_ptr<VSessionStep> m_pSteps;

	// Of a state that others have taken the place of.

	/// What was selected of the document when they did.
	std::vector<NVX::ISelectionItem> m_Selection;
	/// The name of the source, if what took its place brought another one.
	std::optional<std::string> m_SourceName;
};

/// What both hold is the same, and of the same file. Selection, numbers and what is at rest do not count.
bool HoldTheSame(const VTargetState& i_rA, const VTargetState& i_rB);

/// The values are others. Most are the same objects, which is seen at once.
bool Differ(const VSubjectValues& i_rA, const VSubjectValues& i_rB);

/// About how much memory a state takes that another one does not share.
std::size_t BytesBeside(const VTargetState& i_rState, const VTargetState& i_rOther);

} // namespace RetargetSetup
