#pragma once

#include "CoreOrlexQRTIO/SubjectQRTExtras.h"
#include "FBXIO/SkinSkeleton.h"
#include "RetargetSetupCore/History.h"
#include "RetargetSetupCore/SourceAlignment.h"
#include "SetupIO/Setup.h"

#include <boost/filesystem/path.hpp>

#include <ctime>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

/// What was done to a target subject since it was made or loaded, as a recipe tells it.
namespace RetargetSetup
{

/// An edit that a recipe has under a name of its own.
VEdit EditAs(const char* i_pName, const char* i_pCommand, std::optional<std::string> i_Value = {});

/// A file as it was read.
struct VReadFile
{
	/// Empty for none.
	boost::filesystem::path m_Path;
	std::time_t m_Written = 0;
};
VReadFile ReadNow(const boost::filesystem::path& i_rPath);

/// What a target subject was at first.
struct VBeginning
{
	/// What it was made of; empty for one that was not made here.
	VReadFile m_Fbx = {};
	std::string m_Root = {};
	/// The source that it was made for, as the subject names it.
	std::string m_SourceName = {};
	/// What it was loaded from, and what the file held.
	boost::filesystem::path m_Subject = {};
	std::optional<std::string> m_Digest = {};
	bool m_bScaleRootHeight = false;
	/// What making it took.
	std::vector<SetupIO::VEdit> m_Edits = {};
	/// For a file of its own.
	VSubjectValues m_Values = {};
	std::shared_ptr<const CoreOrlexQRTIO::VSubjectQRTExtras> m_pExtras = {};
};

/// The last of a row of steps: immutable but for the one that is still on its way.
struct VSessionStep
{
	VSessionStep() = default;
	/// Without a call for each of those before it.
	~VSessionStep();
	VSessionStep(const VSessionStep&) = default;
	VSessionStep& operator=(const VSessionStep&) = delete;

	std::shared_ptr<VSessionStep> m_pBefore;
	/// Of the first one.
	std::shared_ptr<const VBeginning> m_pBeginning;
	std::vector<SetupIO::VEdit> m_Edits;
	/// The performer then.
	VReadFile m_Source;
	/// What stood before a step that is still on its way.
	VSubjectValues m_Start;
};

/// What a step changed, as edits: targets that were added behind the others, weights, offsets and bind poses.
/// @param i_pSource null for none.
/// @return nothing if edits do not tell it.
std::optional<std::vector<SetupIO::VEdit>> EditsBetween(const VSubjectValues& i_rBefore, const VSubjectValues& i_rAfter,
    const CoreOrlexTypes::VSubjectParametrised* i_pSource);

/// Which a recipe has only with another file than the one before.
inline constexpr const char* c_FbxPoseCommand = "fbx-pose";
inline constexpr const char* c_RebindFbxCommand = "rebind-fbx";
inline constexpr const char* c_AsItStandsCommand = "as-it-stands";
/// Of an alignment: whether the character stands on the skin of a file, or on its joints.
inline constexpr const char* c_SkinCommand = "skin";
inline constexpr const char* c_OnJointsCommand = "on-joints";

/// @param i_Scale that it was made with.
/// @param i_bPoseFromFile whether it took the pose of the file at once.
VBeginning MadeOf(const VReadFile& i_rFbx, const FBXIO::VSkinSkeleton& i_rSkeleton, std::size_t i_Root,
    const std::string& i_rSourceName, double i_Scale, bool i_bPoseFromFile);

/// From all that is reached and nothing locked, and back to it.
VEdit AlignmentEdit(const VAlignmentChoice& i_rChoice, const CoreOrlexTypes::VSubjectParametrised& i_rTarget);

/// How an edit names a segment: by its name where that is one segment's alone, else by its index.
std::string WordOf(std::size_t i_Segment, const CoreOrlexTypes::VSubjectParametrised& i_rSubject);

/// All steps up to this one, with absolute paths and without an output. Neither FBX file nor subject if what it began
/// with is in no file any more.
/// @param o_rChanged sentences on files that have changed since they were read.
SetupIO::VSetup RecipeOf(const VSessionStep& i_rLast, std::vector<std::string>& o_rChanged);

/// All paths relative to a folder, where they can be.
void MakeRelative(SetupIO::VSetup& io_rRecipe, const boost::filesystem::path& i_rFolder);

const VBeginning& BeginningOf(const VSessionStep& i_rLast);

} // namespace RetargetSetup
