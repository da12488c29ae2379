// What moves in an FBX file from anywhere: a take that is read has finite poses in each frame.
#include "../Require.h"

#include "DebugServices/GlobalLog.h"
#include "TakeIO/ReadTake.h"
#include "numerics/AllFinite.h"

extern "C" int LLVMFuzzerTestOneInput(const unsigned char* i_pData, std::size_t i_Size)
{
	using namespace TakeIO;
	static const auto s_pSilence = NVX::GlobalLog::AddSink([](const NVX::VLogCategory&, int, const std::string&) {});
	VTake take;
	std::string error;
	const bool bRead = ReadTakeFrom({reinterpret_cast<const char*>(i_pData), i_Size}, {}, take, error);
	Require(bRead == error.empty() && bRead == !take.m_Joints.empty());
	Require(take.m_Values.size() == take.m_Frames * take.m_Channels);
	std::vector<VJointPose> poses;
	for (std::size_t frame = 0; frame < take.m_Frames; ++frame)
	{
		WorldPoses(take, frame, poses);
		for (const VJointPose& rPose : poses)
			Require(AllFinite(rPose.R) && AllFinite(rPose.t));
	}
	return 0;
}
