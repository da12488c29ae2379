// A take from anywhere: what is read has finite poses in each frame, and what is written of it reads back.
#include "../Require.h"

#include "DebugServices/GlobalLog.h"
#include "TakeIO/BvhWriter.h"
#include "TakeIO/ReadTake.h"
#include "numerics/AllFinite.h"

extern "C" int LLVMFuzzerTestOneInput(const unsigned char* i_pData, std::size_t i_Size)
{
	using namespace TakeIO;
	static const auto s_pSilence = NVX::GlobalLog::AddSink([](const NVX::VLogCategory&, int, const std::string&) {});
	VTakeSettings settings;
	VTake take;
	std::string error;
	const bool bRead = ReadTakeFrom({reinterpret_cast<const char*>(i_pData), i_Size}, settings, take, error);
	Require(bRead == error.empty() && bRead == !take.m_Joints.empty());
	if (!bRead)
		return 0;
	Require(take.m_Values.size() == take.m_Frames * take.m_Channels);
	std::vector<VJointPose> poses;
	for (std::size_t frame = 0; frame < take.m_Frames; ++frame)
	{
		WorldPoses(take, frame, poses);
		for (const VJointPose& rPose : poses)
			Require(AllFinite(rPose.R) && AllFinite(rPose.t));
	}
	settings.m_Up = take.m_FileUp;
	settings.m_Unit = take.m_FileUnit;
	VTake again;
	Require(ReadTakeFrom(PrintBvh(take), settings, again, error));
	Require(again.m_Joints.size() == take.m_Joints.size() && again.m_Frames == take.m_Frames);
	if (take.m_Channels <= 100 && take.m_Frames <= 100)
		Require(Resample(take, 2.5 * take.m_Rate));
	return 0;
}
