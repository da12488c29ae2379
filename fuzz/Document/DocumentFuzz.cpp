// The document's commands in any order, over any two small subjects: after each, what the panel and a save rely on must
// hold.
#include "../../tests/RetargetSetupCore/TestSubjects.h"
#include "../Require.h"

#include "CoreOrlexQRTIO/Reader.h"
#include "CoreOrlexQRTIO/Writer.h"
#include "DebugServices/GlobalLog.h"
#include "InMemoryHost/PluginContext.h"
#include "RetargetSetupDocument/RetargetSetup.h"

#include <fuzzer/FuzzedDataProvider.h>

#include <set>

namespace
{

using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;

constexpr const char* c_Names[] = {"Hips", "LeftArm", "RightArm", "LeftHand", "RightHand", "Spine", "Head", "LeftUpLeg",
    "RightUpLeg", "", "Left", "a b", "<b>\n", "../x", "Hips"};
constexpr const char* c_Lengths[] = {"0", "100*GlobalScale", "-25.5*GlobalScale", "3", "1e300*GlobalScale",
    "(GlobalScale)", "x", "1/0", "2*GlobalScale"};
constexpr double c_Numbers[] = {0.0, 1.0, 0.5, 2.0, -1.0, 1e-300, 1e300, 1.0 / 3.0, 90.0};

VSubjectParametrised MakeAnySubject(FuzzedDataProvider& io_rInput)
{
	VSubjectParametrised subject = MakeSubject({});
	const auto count = io_rInput.ConsumeIntegralInRange<std::uint32_t>(0, 8);
	for (std::uint32_t i = 0; i < count; ++i)
	{
		auto& rSegment = subject.m_Segments.emplace_back();
		rSegment.m_Name = io_rInput.PickValueInArray(c_Names);
		rSegment.m_SegmentIndex = i;
		const auto parent = io_rInput.ConsumeIntegralInRange<std::uint32_t>(0, i);
		if (parent < i)
		{
			rSegment.m_ParentSegmentIndex = parent;
			rSegment.m_TreeDepth = subject.m_Segments[parent].m_TreeDepth + 1;
		}
		for (std::string& rLength : rSegment.m_PreTranslation)
			rLength = io_rInput.PickValueInArray(c_Lengths);
		if (io_rInput.ConsumeBool())
			RetargetSetup::EnableJoint(subject, i, {});
	}
	return subject;
}

VSubjectApplicationData DataOf(const VSubjectParametrised& i_rSubject)
{
	VSubjectApplicationData data;
	data.m_SubjectId = RetargetSetup::c_SubjectId;
	data.m_Segments.resize(i_rSubject.m_Segments.size());
	return data;
}

void CheckModel(const QAbstractItemModel& i_rModel, std::size_t i_Rows, int i_LastRole)
{
	Require(std::size_t(i_rModel.rowCount()) == i_Rows, "a list has a row for each");
	for (int row = 0; row < i_rModel.rowCount(); ++row)
		for (int role = Qt::UserRole; role <= i_LastRole; ++role)
			i_rModel.data(i_rModel.index(row, 0), role);
}

/// What is written is read again, and written the same.
void CheckSave(const VSubjectParametrised& i_rSubject, const VSubjectApplicationData& i_rData,
    const CoreOrlexQRTIO::VSubjectQRTExtras& i_rExtras)
{
	std::vector<std::string> errors;
	std::vector<std::string> warnings;
	std::string first;
	if (!CoreOrlexQRTIO::VWriter().WriteText(
	        i_rSubject, i_rData, i_rExtras, CoreOrlexQRTIO::c_AutomaticVersion, first, errors, warnings))
		return Require(!errors.empty(), "a failed write has a reason");
	VSubjectParametrised subject;
	VSubjectApplicationData data;
	CoreOrlexQRTIO::VSubjectQRTExtras extras;
	if (!CoreOrlexQRTIO::VReader().ReadText(
	        first, i_rSubject.m_Name, i_rSubject.m_SubjectId, subject, data, extras, errors, warnings))
		return Require(!errors.empty(), "a failed read has a reason");
	Require(subject.m_Targets.size() == i_rSubject.m_Targets.size(), "no target is lost");
	Require(subject.m_Segments.size() == i_rSubject.m_Segments.size(), "no segment is lost");
	std::string second;
	Require(CoreOrlexQRTIO::VWriter().WriteText(
	            subject, data, extras, CoreOrlexQRTIO::c_AutomaticVersion, second, errors, warnings),
	    "what was read can be written");
	Require(first == second, "a second write is the same");
}

/// @param io_rSaved the last subject whose save was looked at: most commands change nothing.
void Check(const VRetargetSetup& i_rDocument, VSubjectParametrised& io_rSaved)
{
	const RetargetSetup::VSubjectValues target = i_rDocument.TargetValues();
	if (!target.m_pParametrised)
		return;
	const VSubjectParametrised& rSubject = *target.m_pParametrised;
	const VSubjectApplicationData& rData = *target.m_pApplicationData;
	Require(rData.m_Segments.size() == rSubject.m_Segments.size(), "data for each segment");
	Require(rData.m_Targets.size() == rSubject.m_Targets.size(), "data for each target");
	Require(rData.m_Markers.size() == rSubject.m_Markers.size(), "data for each marker");
	Require(target.m_pSubject->m_Segments.size() == rSubject.m_Segments.size(), "a value for each segment");
	Require(target.m_pSubject->m_Targets.size() == rSubject.m_Targets.size(), "a value for each target");
	std::set<std::uint64_t> identities;
	for (std::size_t i = 0; i < rSubject.m_Targets.size(); ++i)
	{
		for (const std::uint32_t segment : rSubject.m_Targets[i].m_SegmentIndices)
			Require(segment < rSubject.m_Segments.size(), "a target's segment is there");
		const std::uint64_t identity = i_rDocument.TargetIdentity(std::int32_t(i));
		Require(identity != 0 && identities.insert(identity).second, "each target has an identity of its own");
		Require(i_rDocument.TargetOfIdentity(identity) == std::int32_t(i), "a target is found by its identity");
	}
	CheckModel(*i_rDocument.GetTargetModel(), rSubject.m_Targets.size(), VRetargetSetupTargetModel::SelectionItem);
	CheckModel(*i_rDocument.GetTargetSegmentModel(), rSubject.m_Segments.size(), Qt::UserRole + 30);
	if (rSubject == io_rSaved)
		return;
	io_rSaved = rSubject;
	CheckSave(rSubject, rData, i_rDocument.GetTargetExtras());
}

void Command(VRetargetSetup& io_rDocument, FuzzedDataProvider& io_rInput)
{
	const auto index = [&] { return io_rInput.ConsumeIntegralInRange<int>(-1, 9); };
	const auto number = [&] { return io_rInput.PickValueInArray(c_Numbers); };
	const auto target = [&]
	{
		return QVariantMap{
		    {"source", index()}, {"target", index()}, {"position", io_rInput.ConsumeBool()}, {"weight", number()}};
	};
	switch (io_rInput.ConsumeIntegralInRange<int>(0, 18))
	{
	case 0: return io_rDocument.AddTarget(index(), index(), io_rInput.ConsumeBool(), io_rInput.ConsumeBool());
	case 1: return io_rDocument.RemoveTarget(index());
	case 2: return io_rDocument.CreateAllJoints();
	case 3: return io_rDocument.RemoveUnnecessaryJoints();
	case 4: return io_rDocument.UpdateTargets();
	case 5: return io_rDocument.SetTargetScale(number());
	case 6: return io_rDocument.SetScaleRootHeight(io_rInput.ConsumeBool());
	case 7: return io_rDocument.SetJointSymmetry(io_rInput.ConsumeBool());
	case 8: return io_rDocument.Undo();
	case 9: return io_rDocument.Redo();
	case 10: return io_rDocument.MatchFilePose();
	case 11: io_rDocument.ProposeTargets(number()); return;
	case 12: return io_rDocument.AddTargets({target(), target()});
	case 13:
		io_rDocument.AlignToSource(
		    {true, true, true, true}, {index()}, io_rInput.ConsumeBool(), io_rInput.ConsumeBool());
		return;
	case 14: return io_rDocument.EndAlignment(io_rInput.ConsumeBool());
	case 15:
	{
		const auto pModel = io_rDocument.GetTargetModel();
		pModel->setData(
		    pModel->index(index(), 0), number(), Qt::UserRole + io_rInput.ConsumeIntegralInRange<int>(0, 20));
		return;
	}
	case 16:
	{
		const auto pModel = io_rDocument.GetTargetSegmentModel();
		pModel->setData(pModel->index(index(), 0), io_rInput.ConsumeBool(),
		    Qt::UserRole + io_rInput.ConsumeIntegralInRange<int>(0, 20));
		return;
	}
	case 17: return io_rDocument.RemoveJoint(index());
	default:
	{
		VSubjectParametrised subject = MakeAnySubject(io_rInput);
		VSubjectApplicationData data = DataOf(subject);
		if (io_rInput.ConsumeBool())
			io_rDocument.SetSourceSubject(std::move(subject), std::move(data));
		else
			io_rDocument.SetTargetSubject(std::move(subject), std::move(data));
	}
	}
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* i_pData, std::size_t i_Size)
{
	static const auto s_pSilence = NVX::GlobalLog::AddSink([](const NVX::VLogCategory&, int, const std::string&) {});
	FuzzedDataProvider input(i_pData, i_Size);
	InMemoryHost::VPluginContext host;
	VRetargetSetup document(host.GetDispatcher(), host.GetFrameFactory(), host.GetItemFactory());
	document.KeepHistory(nullptr);
	for (const bool bSource : {true, false})
	{
		VSubjectParametrised subject = MakeAnySubject(input);
		VSubjectApplicationData data = DataOf(subject);
		if (bSource)
			document.SetSourceSubject(std::move(subject), std::move(data));
		else
			document.SetTargetSubject(std::move(subject), std::move(data));
	}
	VSubjectParametrised saved;
	Check(document, saved);
	for (int commands = 0; commands < 24 && input.remaining_bytes() > 0; ++commands)
	{
		Command(document, input);
		Check(document, saved);
	}
	// All the way back and forth again leads to the same.
	VSubjectParametrised last;
	const bool bLast = document.GetTargetSubject(last);
	int steps = 0;
	for (; !document.UndoName().isEmpty(); ++steps)
		document.Undo();
	Check(document, saved);
	for (; steps > 0; --steps)
		document.Redo();
	VSubjectParametrised again;
	Require(document.GetTargetSubject(again) == bLast && again == last, "what was undone is done again");
	return 0;
}
