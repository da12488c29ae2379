// A take that plays while others edit, open and cancel: what is drawn and told is of what the document has.

#include "../WaitFor.h"
#include "Host.h"

#include "CoreOrlexTypes/JointType.h"
#include "CoreOrlexTypes/SubjectState.h"
#include "InMemoryHost/Flow.h"
#include "TakeIO/ReadTake.h"
#include "TakeSolve/Performer.h"
#include "studio/motion/MotionExport.h"
#include "studio/motion/TakePlayer.h"

#include <functional>
#include <optional>

namespace
{

using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectParametrised;
using TesselPluginInterface::IFlowFrame;
using TesselPluginInterface::ItemValue;
using VpSubject = std::shared_ptr<const VSubjectParametrised>;

const QString c_Take = RETARGET_TEST_DATA "/motion/chest_yxz_120fps.bvh";

/// A performer with a target on each segment, which follows the take's joint of the same name.
VSubjectParametrised Follower()
{
	TakeIO::VTake take;
	std::string error;
	EXPECT_TRUE(TakeIO::ReadTake(c_Take.toStdString(), {}, take, error)) << error;
	std::vector<TakeSolve::VFinding> findings;
	VSubjectParametrised subject =
	    TakeSolve::MakePerformer(take, TakeSolve::StandingPose(take), "hero", findings).m_SubjectParametrised;
	subject.m_Markers.clear();
	for (std::uint32_t i = 0; i < subject.m_Segments.size(); ++i)
	{
		subject.m_Markers.emplace_back().m_Name = subject.m_Segments[i].m_Name;
		VSubjectParametrised::VTarget& rTarget = subject.m_Targets.emplace_back();
		rTarget.m_Type = VSubjectParametrised::VTarget::ELocalPointToWorldPoint;
		rTarget.m_SegmentIndices = {i};
		rTarget.m_MarkerIndices = {i};
		rTarget.m_StateExpressions = {"0", "0", "0"};
	}
	return subject;
}

VpSubject Edited(const std::function<void(VSubjectParametrised&)>& i_rEdit)
{
	VSubjectParametrised subject = Follower();
	i_rEdit(subject);
	return std::make_shared<const VSubjectParametrised>(std::move(subject));
}

VpSubject Weighted(double i_Weight)
{
	return Edited([&](VSubjectParametrised& io_rSubject) { io_rSubject.m_Targets.back().m_Weight = i_Weight; });
}

/// As where joints were removed.
VpSubject WithFewerJoints()
{
	return Edited(
	    [](VSubjectParametrised& io_rSubject)
	    {
		    VSubjectParametrised::VJoint& rJoint = io_rSubject.m_Segments[1].m_Joint;
		    rJoint = {};
		    rJoint.m_JointType = VSubjectParametrised::VJoint::EDummy;
	    });
}

struct VPlaying
{
	NVX::CountedPointer<IFlowFrame> Shown(const VpSubject& i_rpTarget, const VpSubject& i_rpSource = {})
	{
		NVX::CountedPointer<IFlowFrame> pDocument(new InMemoryHost::VFlowFrame);
		const auto add = [&](const char* i_pName, const VpSubject& i_rpSubject)
		{
			const auto pItem = m_pItems->CreateItem(i_pName);
			TesselPluginInterface::SetItemValue(pItem, i_rpSubject);
			pDocument->AddItem(pItem);
		};
		add("FlowSubjectParametrised", i_rpSource);
		add("FlowSubjectParametrisedForSolving", i_rpTarget);
		return m_Player.Shown(pDocument);
	}

	static std::vector<double> States(const NVX::CountedPointer<IFlowFrame>& i_rpShown)
	{
		const auto pPose = i_rpShown ? ItemValue<CoreOrlexTypes::VSubjectDynamicParameters>(
		                       i_rpShown->Item("FlowSubjectDynamicParametersForSolving"))
		                             : nullptr;
		return pPose ? pPose->m_State : std::vector<double>();
	}

	/// Until the document's subjects are solved.
	bool IsSolved(const VpSubject& i_rpTarget)
	{
		return WaitFor([&] { return m_Player.AtRest() && m_Player.Judged(); }, 60000)
		    && m_Player.Judged()->m_Of.m_pTarget == i_rpTarget && m_Player.Picture()->m_Of.m_pTarget == i_rpTarget;
	}

	const NVX::CountedPointer<TesselPluginInterface::IItemFactory> m_pItems{new InMemoryHost::VItemFactory};
	StudioHost::VTakePlayer m_Player{m_pItems, new InMemoryHost::VFrameFactory};
};

std::size_t NumberOfStates(const VSubjectParametrised& i_rSubject)
{
	return TakeSolve::VPosedSubject(i_rSubject).m_BindPose.size();
}

TEST(TakePlayer, StatesAreOfTheSubjectThatIsDrawn)
{
	VPlaying playing;
	const VpSubject pWhole = Weighted(1.0), pHeavier = Weighted(2.0), pFewer = WithFewerJoints();
	playing.Shown(pWhole);
	playing.m_Player.Open(c_Take, 20);
	ASSERT_TRUE(playing.IsSolved(pWhole));
	const std::vector<double> solved = playing.States(playing.Shown(pWhole));
	ASSERT_EQ(solved.size(), NumberOfStates(*pWhole));
	EXPECT_NE(solved, TakeSolve::VPosedSubject(*pWhole).m_BindPose);

	EXPECT_EQ(playing.States(playing.Shown(pHeavier)), solved) << "an edit of the same joints is seen in their pose";
	EXPECT_FALSE(playing.m_Player.Picture()) << "but its residuals are not known yet";
	const std::vector<double> bindPose = TakeSolve::VPosedSubject(*pFewer).m_BindPose;
	ASSERT_LT(bindPose.size(), solved.size());
	EXPECT_EQ(playing.States(playing.Shown(pFewer)), bindPose) << "of other joints they would be nonsense";
	ASSERT_TRUE(playing.IsSolved(pFewer));
	EXPECT_EQ(playing.States(playing.Shown(pFewer)).size(), bindPose.size());
	EXPECT_NE(playing.States(playing.Shown(pFewer)), bindPose);
	EXPECT_FALSE(playing.Shown(pFewer, pWhole)) << "a performer who is gone is not drawn";
	ASSERT_TRUE(playing.IsSolved(pFewer));
	EXPECT_TRUE(playing.Shown(pFewer, pWhole));
}

TEST(TakePlayer, EditsOpeningsAndSeeksEndWithTheLastOfThem)
{
	VPlaying playing;
	const VpSubject subjects[] = {Weighted(1.0), WithFewerJoints(), Weighted(3.0)};
	playing.Shown(subjects[0]);
	playing.m_Player.Open(c_Take);
	for (int i = 0; i < 60; ++i)
	{
		const VpSubject& rpTarget = subjects[i % 3];
		const auto pShown = playing.Shown(rpTarget);
		EXPECT_TRUE(!pShown || playing.States(pShown).size() == NumberOfStates(*rpTarget)) << i;
		playing.m_Player.Seek(i);
		if (i % 7 == 0)
			playing.m_Player.Open(c_Take, std::size_t(i));
		if (i % 11 == 0)
			playing.m_Player.Cancel();
		playing.m_Player.SetGhost(i % 2 == 0);
		for (int wait = i % 5; wait > 0; --wait)
			QCoreApplication::processEvents(QEventLoop::AllEvents, 2);
	}
	playing.Shown(subjects[1]);
	ASSERT_TRUE(WaitFor([&] { return !playing.m_Player.IsReading(); }, 60000));
	playing.Shown(subjects[2]);
	EXPECT_TRUE(playing.IsSolved(subjects[2]));
	// Its end comes in the middle of a sequence.
	playing.Shown(subjects[1]);
}

TEST(TakePlayer, WhatIsNotExportedIsToldAndLeavesNoFile)
{
	VPlaying playing;
	const VpSubject pTarget = Weighted(1.0);
	playing.Shown(pTarget);
	playing.m_Player.Open(c_Take);
	ASSERT_TRUE(playing.IsSolved(pTarget));
	const QTemporaryDir folder;
	const QString taken = WriteFile(folder.filePath("walk.bvh"), "as it was");
	const QString damaged = WriteFile(folder.filePath("hero.fbx"), "no such file");
	StudioHost::VMotionExport writer;
	const struct
	{
		QString m_Path;
		QString m_Character;
		QString m_Told;
	} rows[] = {{folder.filePath("a.txt"), {}, "is written as .bvh, .glb or .fbx"},
	    {folder.filePath("a.glb"), {}, "Choose its FBX file"}, {taken, {}, "is not replaced"},
	    {folder.filePath("a.fbx"), damaged, "could not be read as a character"},
	    {folder.filePath("a.glb"), folder.filePath("gone.fbx"), "could not be read"},
	    {folder.filePath("none/a.bvh"), {}, "none"}, {folder.filePath("part.bvh"), {}, ""},
	    {folder.filePath("other.glb"), RETARGET_SOURCE "/demo/character.fbx", "No bone has the name"}};
	for (const auto& rRow : rows)
	{
		std::optional<QString> told;
		const auto connection = QObject::connect(&writer, &StudioHost::VMotionExport::done,
		    [&](const QString&, const QString& i_rError) { told = i_rError; });
		const QString refused = writer.Begin({playing.m_Player.Judged(), 10, 19, rRow.m_Path, rRow.m_Character, taken});
		if (!refused.isEmpty())
			told = refused;
		ASSERT_TRUE(WaitFor([&] { return told.has_value(); }, 60000));
		QObject::disconnect(connection);
		EXPECT_TRUE(rRow.m_Told.isEmpty() ? told->isEmpty() : told->contains(rRow.m_Told)) << told->toStdString();
		EXPECT_FALSE(writer.IsRunning());
	}
	EXPECT_EQ(QDir(folder.path()).entryList(QDir::Files), QStringList({"hero.fbx", "part.bvh", "walk.bvh"}));
	EXPECT_EQ(ReadFile(taken), "as it was");
	TakeIO::VTake part;
	std::string error;
	ASSERT_TRUE(TakeIO::ReadTake(folder.filePath("part.bvh").toStdString(), {}, part, error)) << error;
	EXPECT_EQ(part.m_Frames, 10u);
	EXPECT_EQ(part.m_Joints.size(), pTarget->m_Segments.size());
}

} // namespace
