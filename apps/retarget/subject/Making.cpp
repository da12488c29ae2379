#include "retarget/subject/Making.h"

#include "CommandLineText/Messages.h"
#include "retarget/subject/Aligning.h"

#include "DebugServices/GlobalLog.h"
#include "RetargetSetupCore/FilePose.h"

namespace CommandLine
{

void MakeSubject(VSession& io_rSession, const VMaking& i_rMaking, const VEdits& i_rEdits)
{
	io_rSession.Document().SetScaleRootHeight(i_rMaking.m_RootHeight == c_pScaleRootHeight);
	io_rSession.m_bFitsScale = i_rMaking.m_bTyped && i_rMaking.m_RootHeight.empty() && LeavesScale(i_rEdits);
	io_rSession.m_bOffsetsFollowScale = i_rMaking.m_bTyped;
	const auto loadSource = [&]
	{
		if (!i_rMaking.m_Source.empty())
			io_rSession.LoadSource(i_rMaking.m_Source);
	};
	if (i_rMaking.m_Fbx.empty())
	{
		io_rSession.LoadTarget(i_rMaking.m_Subject);
		loadSource();
		ApplyEdits(io_rSession, i_rEdits);
		return ReportPose(io_rSession);
	}
	// The target subject takes the source's name when it is made.
	loadSource();
	io_rSession.CreateTarget(i_rMaking.m_Fbx, i_rMaking.m_Root, TakesProposal(i_rEdits), i_rMaking.m_RootWhere);
	if (const auto worst = io_rSession.Document().DifferenceFromFile())
		NVX_LOG(c_pCategory, NVX::ELogWarning,
		    "The bind pose as built differs from the pose in the file, %1%; --match-file-pose mends it",
		    RetargetSetup::WorstText(io_rSession.Target(), *worst));
	ApplyEdits(io_rSession, i_rEdits);
	ReportPose(io_rSession);
	io_rSession.ForgetNamelessFiles();
}

} // namespace CommandLine
