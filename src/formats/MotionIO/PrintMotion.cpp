#include "MotionIO/PrintMotion.h"

#include "MotionIO/Bones.h"
#include "MotionIO/BvhMotion.h"
#include "MotionIO/FbxMotion.h"
#include "MotionIO/GltfMotion.h"

std::optional<MotionIO::EMotionForm> MotionIO::MotionFormOf(std::string_view i_Extension)
{
	if (i_Extension == ".bvh")
		return EMotionForm::Bvh;
	if (i_Extension == ".glb")
		return EMotionForm::Gltf;
	if (i_Extension == ".fbx")
		return EMotionForm::Fbx;
	return std::nullopt;
}

MotionIO::EPrinted MotionIO::PrintMotion(const TakeIO::VTake& i_rMotion, EMotionForm i_Form,
    const VCharacterFile* i_pCharacter, const VMotionSettings& i_rSettings, std::string& o_rBytes,
    std::string& o_rError)
{
	const auto end = [&o_rError](EPrinted i_Printed, const char* i_pWhy)
	{
		o_rError = i_pWhy;
		return i_Printed;
	};
	if (i_rMotion.m_Joints.empty() || i_rMotion.m_Frames == 0)
		return end(EPrinted::Refused, "The motion has no frames");
	if (!(i_rSettings.m_Scale > 0.0))
		return end(EPrinted::Refused, "A scale must be above 0");
	VBones bones;
	if (i_pCharacter && !bones.Read(*i_pCharacter, o_rError))
		return EPrinted::CharacterUnreadable;
	if (i_Form == EMotionForm::Bvh)
		return PrintBvhMotion(i_pCharacter ? &bones : nullptr, i_rMotion, i_rSettings, o_rBytes);
	if (!i_pCharacter)
		return end(EPrinted::Refused, "This form holds the character, too, whose FBX file is not given");
	return i_Form == EMotionForm::Gltf
	    ? PrintGltfMotion(bones, *i_pCharacter, i_rMotion, i_rSettings, o_rBytes, o_rError)
	    : PrintFbxMotion(bones, i_pCharacter->m_Bytes, i_rMotion, i_rSettings, o_rBytes, o_rError);
}
