#include "retarget/Commands.h"
#include "retarget/Output.h"

#include "FBXIO/FBXReader.h"

namespace CommandLine
{
namespace
{

VJson MatrixToJson(const QMatrix4x4& i_rMatrix)
{
	VJson values = VJson::array();
	for (int row = 0; row < 4; ++row)
		for (int column = 0; column < 4; ++column)
			values.push_back(i_rMatrix(row, column));
	return values;
}

VJson BonesToJson(const FBXIO::VSkinSkeleton& i_rSkeleton)
{
	VJson bones = VJson::array();
	for (const FBXIO::VSkinBone& rBone : i_rSkeleton)
	{
		VJson bone = VJson::object();
		bone["name"] = rBone.m_Name;
		bone["parent"] = rBone.m_ParentIndex;
		bone["accumulatedScale"] = rBone.m_AccumulatedScale;
		bone["preRotation"] = MatrixToJson(rBone.m_PreRotation);
		bone["inverseBind"] = MatrixToJson(rBone.m_InverseBind);
		bone["local"] = MatrixToJson(rBone.m_Local);
		bone["global"] = MatrixToJson(rBone.m_Global);
		bones.push_back(std::move(bone));
	}
	return bones;
}

EExitStatus ShowFbx(const std::string& i_rPath)
{
	FBXIO::FBXReader reader;
	if (!reader.LoadFile(i_rPath))
		throw VCommandError(EBadInput, "\"" + i_rPath + "\" could not be read as FBX");
	VJson result = VJson::object();
	result["upAxis"] = reader.GetUpAxis();
	result["unitScale"] = reader.GetUnitScale();
	result["bones"] = reader.HasSkeleton() ? BonesToJson(*reader.GetSkeleton()) : VJson::array();
	PrintJson(result);
	if (!reader.IsComplete())
		throw VCommandError(EBadInput, "\"" + i_rPath + "\" was read only in part; what was read is shown");
	return EFine;
}

} // namespace

VCommand AddFbxCommand(CLI::App& io_rProgram)
{
	CLI::App* const pApp = AddCommand(io_rProgram, "fbx",
	    "Show what an FBX file holds as JSON: up axis (0 X, 1 Y, 2 Z), unit scale (file units to millimetres) and the "
	    "bones with their matrices (row by row, translations in millimetres)",
	    {"fbx hero.fbx", "fbx hero.fbx | jq -r '.bones[].name'"});
	const auto pPath = std::make_shared<std::string>();
	pApp->add_option("FILE", *pPath, "FBX file, binary or ASCII")->required();
	return {pApp, [pPath] { return ShowFbx(*pPath); }};
}

} // namespace CommandLine
