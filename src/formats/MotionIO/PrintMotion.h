#pragma once

#include "TakeIO/Take.h"

#include <functional>
#include <optional>
#include <string>
#include <string_view>

namespace MotionIO
{

enum class EMotionForm
{
	/// Joints alone; at rest all stand unturned, as programs that read BVH expect.
	Bvh,
	/// glTF binary: the character with its skin, and the motion. Metres, Y up.
	Gltf,
	/// The character's own file with one more animation stack.
	Fbx
};

/// By an extension in lower case, with its dot: ".bvh", ".glb", ".fbx".
std::optional<EMotionForm> MotionFormOf(std::string_view i_Extension);

/// An FBX file.
struct VCharacterFile
{
	/// For messages; its textures are looked for beside it.
	std::string m_Path;
	std::string m_Bytes;
};

struct VMotionSettings
{
	/// Of the stack or the animation.
	std::string m_Name = "motion";
	/// How many times larger than the character of the file the one that moves is. Its motion is brought to the size
	/// of the file.
	double m_Scale = 1.0;
	/// Called with what is done, from 0 to 1; false ends it. Empty for none.
	std::function<bool(double)> m_Progress;
};

enum class EPrinted
{
	Done,
	CharacterUnreadable,
	/// Such a character, or such a motion, cannot be printed in that form.
	Refused,
	Cancelled
};

/// A motion of a character as the bytes of a file. Joints are the character's bones by name, with namespaces or
/// without; of several with one name the first is the first. A bone without a joint stays in its place on its parent, a
/// joint without a bone is told in the log category "MotionIO". What a motion's joints are in the world, their bones
/// become: with VTake::m_FileUp of Z their frames are those of the bones as segments of a retarget subject hold them.
/// @param i_pCharacter null is enough for BVH, which is then in the axes and unit of the take
/// @param o_rBytes as it was unless all is done
/// @param o_rError why not
EPrinted PrintMotion(const TakeIO::VTake& i_rMotion, EMotionForm i_Form, const VCharacterFile* i_pCharacter,
    const VMotionSettings& i_rSettings, std::string& o_rBytes, std::string& o_rError);

} // namespace MotionIO
