#pragma once

#include <boost/format.hpp>

#include <string>

/// Why a command of the document ended without a change, as the operator is told.
namespace RetargetSetup::Ignored
{

inline constexpr const char* c_NoFBX = "No skeleton has been read from an FBX file. Choose a target FBX first.";
inline constexpr const char* c_NoRootBone = "The FBX skeleton has no such root bone. Choose a target root.";
inline constexpr const char* c_NoSource = "There is no source subject. Choose a source skeleton first.";
inline constexpr const char* c_NoTarget = "There is no target subject. Create one, or open a retarget subject file.";
inline constexpr const char* c_NoSourceSegment = "No single segment of the source subject is selected.";
inline constexpr const char* c_NoTargetSegment = "No single segment of the target subject is selected.";
inline constexpr const char* c_NoJointToRemove =
    "The target subject has no such segment with a joint that can go; the root's stays.";
inline constexpr const char* c_NoSelectedTarget = "No single target is selected.";
inline constexpr const char* c_SourceNoTree = "The segments of the source subject make no tree with joints.";
inline constexpr const char* c_TargetNoTree = "The segments of the target subject make no tree with joints.";
inline constexpr const char* c_NotItsFBX =
    "The segments of the target subject are not the bones of the FBX file. Choose the FBX file that it was made from.";
inline constexpr const char* c_OwnJoints =
    "The target subject has joints, post poses or parameters of its own, which the pose of an FBX file does not fit.";
inline constexpr const char* c_HostRefused = "The host took no item for the change, so everything stays as it was.";
inline constexpr const char* c_TargetKept = "The target subject has changes that are not saved, and stays.";
inline constexpr const char* c_PairsAreThere = "There is nothing to add: all these targets are there already.";
inline constexpr const char* c_NoPairs =
    "The target subject has no position or rotation target that a preset could hold. Add targets first.";
inline constexpr const char* c_BeginningGone =
    "What the steps began with is in no file any more. \"Save as Recipe\" keeps it in a file beside the recipe.";
inline constexpr const char* c_NothingToUndo = "There is nothing to undo.";
inline constexpr const char* c_NothingToRedo = "There is nothing to redo.";
/// The target's name is %1%.
inline constexpr const char* c_PairIsThere = "There is a target '%1%' already.";
/// The rest take the file or URL as %1%.
inline constexpr const char* c_NotLocal = "'%1%' is no file on this computer.";
inline constexpr const char* c_NotOpened = "'%1%' cannot be opened. The target subject is still the one before.";
inline constexpr const char* c_LaterVersion =
    "'%1%' was written by a later version, which this one cannot read. The target subject is still the one before.";
inline constexpr const char* c_NotRead = "'%1%' could not be loaded. The target subject is still the one before.";
inline constexpr const char* c_LegacyOnlyRead =
    "Nothing was saved: '%1%' is a legacy file, and those are only read. Choose a name that ends in .qrr.";
inline constexpr const char* c_FileKept = "Nothing was saved: '%1%' was changed by another program, and stays.";
/// The reason is %2%.
inline constexpr const char* c_NotSaved = "Nothing was saved, and '%1%' is as it was. %2%";

/// One of these texts with what stands in it.
template <typename... TValues>
std::string Text(const char* i_pText, const TValues&... i_rValues)
{
	return (boost::format(i_pText) % ... % i_rValues).str();
}

} // namespace RetargetSetup::Ignored
