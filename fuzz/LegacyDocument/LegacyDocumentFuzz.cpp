// A legacy text file is the one entrance that checks nothing of a subject but its form: whatever it holds goes through
// the document's commands and must leave lists that run parallel.
#include "../Require.h"

#include "DebugServices/GlobalLog.h"
#include "InMemoryHost/PluginContext.h"
#include "RetargetSetupCore/LegacyText.h"
#include "RetargetSetupCore/RetargetTargets.h"
#include "RetargetSetupDocument/RetargetSetup.h"

namespace
{

void CheckParallel(const VRetargetSetup& i_rDocument)
{
	const auto target = i_rDocument.TargetValues();
	const auto& rSubject = *target.m_pParametrised;
	const auto& rData = *target.m_pApplicationData;
	Require(rData.m_Markers.size() == rSubject.m_Markers.size());
	Require(rData.m_Segments.size() == rSubject.m_Segments.size());
	Require(rData.m_Targets.size() == rSubject.m_Targets.size());
	Require(target.m_pSubject->m_Segments.size() == rSubject.m_Segments.size());
	const auto pModel = i_rDocument.GetTargetModel();
	Require(std::size_t(pModel->rowCount()) == rSubject.m_Targets.size());
	for (int row = 0; row < pModel->rowCount(); ++row)
		for (int role = VRetargetSetupTargetModel::SourceSegment; role <= VRetargetSetupTargetModel::SelectionItem;
		     ++role)
			pModel->data(pModel->index(row, 0), role);
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const unsigned char* i_pData, std::size_t i_Size)
{
	static const auto s_pSilence = NVX::GlobalLog::AddSink([](const NVX::VLogCategory&, int, const std::string&) {});
	CoreOrlexTypes::VSubjectRecord record;
	if (RetargetSetup::ParseLegacyText({reinterpret_cast<const char*>(i_pData), i_Size}, record) != 0)
		return 0;
	RetargetSetup::RepairLegacyRecord(record);

	InMemoryHost::VPluginContext host;
	VRetargetSetup document(host.GetDispatcher(), host.GetFrameFactory(), host.GetItemFactory());
	document.SetSourceSubject(record.m_SubjectParametrised, record.m_SubjectApplicationData);
	document.SetTargetSubject(record.m_SubjectParametrised, record.m_SubjectApplicationData);
	CheckParallel(document);
	const int last = int(record.m_SubjectParametrised.m_Segments.size()) - 1;
	document.AddTarget(0, last, true, true);
	document.AddTarget(last, 0, false, true);
	document.UpdateTargets();
	document.RemoveUnnecessaryJoints();
	document.CreateAllJoints();
	CheckParallel(document);
	CoreOrlexTypes::VSubjectParametrised subject;
	document.GetTargetSubject(subject);
	for (std::size_t component = 0; component < 3; ++component)
		RetargetSetup::SetStateExpression(subject, record.m_SubjectParametrised.m_Model, 0, component);
	document.SetTargetSubjectParametrised(subject);
	document.SetTargetScale(2.0);
	document.RemoveTarget(0);
	document.RemoveTarget(int(subject.m_Targets.size()) - 2);
	CheckParallel(document);
	return 0;
}
