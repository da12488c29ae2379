#include "TakeIO/ReadTake.h"

#include "DebugServices/GlobalLog.h"
#include "TakeIO/BvhReader.h"
#include "TakeIO/FbxTakeReader.h"
#include "TakeIO/Limits.h"
#include "UtilsFileSystem/Files.h"
#include "UtilsFileSystem/Paths.h"

#include <set>

namespace
{

using namespace TakeIO;

/// Segments are found by name.
void TellRepeatedNames(const VTake& i_rTake)
{
	std::set<std::string_view> names;
	std::size_t repeated = 0;
	std::string_view example;
	for (const VJoint& rJoint : i_rTake.m_Joints)
		if (!names.insert(rJoint.m_Name).second)
		{
			++repeated;
			example = rJoint.m_Name;
		}
	if (repeated > 0)
		NVX_LOG("TakeIO", NVX::ELogWarning, "Joints whose name another joint has, too: %1%, such as \"%2%\"", repeated,
		    example);
}

bool ReadAny(std::string_view i_Bytes, const VTakeSettings& i_rSettings, VTake& o_rTake, std::string& o_rError)
{
	if (IsBvh(i_Bytes))
		return ReadBvh(i_Bytes, i_rSettings, o_rTake, o_rError);
	if (IsFbx(i_Bytes))
		return ReadFbxTake(i_Bytes, i_rSettings, o_rTake, o_rError);
	o_rError = i_Bytes.empty() ? "It is empty" : "It is neither a BVH file nor an FBX file";
	return false;
}

} // namespace

bool TakeIO::ReadTakeFrom(
    std::string_view i_Bytes, const VTakeSettings& i_rSettings, VTake& o_rTake, std::string& o_rError)
{
	VTake take;
	if (!ReadAny(i_Bytes, i_rSettings, take, o_rError))
		return false;
	TellRepeatedNames(take);
	if (i_rSettings.m_Rate && !Resample(take, *i_rSettings.m_Rate))
	{
		o_rError = "At that rate it has more than " + std::to_string(Limits::c_Values) + " values";
		return false;
	}
	o_rTake = std::move(take);
	return true;
}

bool TakeIO::ReadTake(
    const std::string& i_rPath, const VTakeSettings& i_rSettings, VTake& o_rTake, std::string& o_rError)
{
	std::string bytes;
	const boost::filesystem::path path = UtilsFileSystem::PathFromUtf8(i_rPath);
	return UtilsFileSystem::ReadWholeFile(path, Limits::c_FileBytes, bytes, o_rError) == 0
	    && ReadTakeFrom(bytes, i_rSettings, o_rTake, o_rError);
}
