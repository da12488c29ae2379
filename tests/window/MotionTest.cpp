// A take by mouse and keyboard: it is played, judged as the command line judges it, and leaves the document as it is.

#include "WindowFixture.h"

#include "InMemoryHost/Flow.h"
#include "NVX/ISelectionItem.h"
#include "TakeIO/BvhWriter.h"
#include "TakeIO/ReadTake.h"
#include "TakeSolve/PosedSubject.h"
#include "TakeSolve/SolvedMotion.h"
#include "TakeSolve/TargetWords.h"
#include "TesselPluginInterface/ISelectionManager.h"
#include "studio/host/Services.h"
#include "studio/motion/ResidualPlot.h"
#include "studio/motion/TakePlayer.h"
#include "studio/motion/TimeLine.h"
#include "studio/panel/RetargetPanel.h"

#include <QAction>
#include <QCheckBox>
#include <QFile>
#include <QJsonArray>
#include <QJsonDocument>
#include <QJsonObject>
#include <QLabel>
#include <QMenu>
#include <QTableView>
#include <QTest>
#include <QToolButton>

#include <cmath>

namespace
{

using CoreOrlexTypes::VSubjectParametrised;
using StudioHost::VJudgedTake;
using StudioHost::VTakePlayer;

constexpr std::size_t c_Frames = 60;

class Motion : public Window
{
protected:
	void SetUp() override
	{
		Window::SetUp();
		Run({"create", "--fbx", File("character.fbx"), "--source", File("performer.qrs"), "--edits",
		    RETARGET_SOURCE "/demo/mapping.json", "--prune-joints", "--match-file-pose", "--update-targets", "-o",
		    File("hero.qrr")});
		for (const char* const pName : {"performer.qrs", "hero.qrr"})
			ASSERT_TRUE(m_pWindow->Open(File(pName)));
		EXPECT_EVENTUALLY(Targets() > 30 && m_pOperator->Property("sourceSegments", "count").toInt() > 20);
		WriteTake();
	}

	VTakePlayer& Player() { return m_pWindow->Motion(); }
	template <typename TWidget>
	TWidget& Widget(const char* i_pName)
	{
		auto* const pWidget = m_pWindow->findChild<TWidget*>(QLatin1String(i_pName));
		EXPECT_TRUE(pWidget && pWidget->isVisible()) << i_pName;
		return *pWidget;
	}
	void Press(const char* i_pButton) { QTest::mouseClick(&Widget<QToolButton>(i_pButton), Qt::LeftButton); }

	/// What the document shows, and would save.
	std::shared_ptr<const VSubjectParametrised> Target() { return Subject("FlowSubjectParametrisedForSolving"); }
	std::shared_ptr<const VSubjectParametrised> Subject(const char* i_pItem)
	{
		return TesselPluginInterface::ItemValue<VSubjectParametrised>(Player().Document()->Item(i_pItem));
	}

	/// The performer sways, from its bind pose and back.
	void WriteTake()
	{
		const TakeSolve::VPosedSubject performer(*Subject("FlowSubjectParametrised"));
		TakeSolve::VSolvedTake states;
		states.m_Frames = c_Frames;
		states.m_NumberOfStates = performer.m_BindPose.size();
		for (std::size_t frame = 0; frame < c_Frames; ++frame)
			for (std::size_t i = 0; i < performer.m_BindPose.size(); ++i)
				states.m_States.push_back(performer.m_BindPose[i]
				    + (i < 6 ? 0.0
				             : 0.3 * std::sin(2.0 * M_PI * double(frame) / double(c_Frames - 1) * double(1 + i % 3))));
		QFile file(File("sway.bvh"));
		ASSERT_TRUE(file.open(QIODevice::WriteOnly));
		file.write(
		    TakeIO::PrintBvh(TakeSolve::MotionOf(performer.m_Subject, performer.m_BindPose, states, 30.0)).c_str());
	}

	void ExpectNumbersOfTheCommandLine(const char* i_pSubject)
	{
		EXPECT_EVENTUALLY(Player().AtRest() && Player().Judged());
		ASSERT_TRUE(Player().Judged());
		const QJsonObject json = QJsonDocument::fromJson(
		    Run({"solve", File(i_pSubject), "--take", File("sway.bvh"), "--source", File("performer.qrs"), "--json"}))
		                             .object();
		const QJsonArray targets = json["targets"].toArray();
		const VJudgedTake& rJudged = *Player().Judged();
		ASSERT_EQ(std::size_t(targets.size()), rJudged.m_Report.m_Targets.size());
		double sum = 0.0;
		for (int i = 0; i < targets.size(); ++i)
		{
			const QJsonObject target = targets[i].toObject();
			const TakeSolve::VTargetQuality& rQuality = rJudged.m_Report.m_Targets[std::size_t(i)];
			const double factor = TakeSolve::UnitFactor(rJudged.m_pTarget->m_Subject.m_Targets[std::size_t(i)]);
			EXPECT_NEAR(target["rms"].toDouble(), factor * rQuality.m_Rms, 1e-6) << i;
			EXPECT_NEAR(target["p95"].toDouble(), factor * rQuality.m_P95, 1e-6) << i;
			EXPECT_EQ(target["maxFrame"].toInt(), int(rQuality.m_MaxFrame)) << i;
			sum += factor * rQuality.m_Rms;
		}
		EXPECT_GT(sum, 1.0);
	}
};

TEST_F(Motion, IsPlayedJudgedAndLeavesTheDocument)
{
	m_pOperator->ClickRow("targetSegments", RowOf("targetSegments", "skull"));
	m_pOperator->WaitForDrawing();
	const auto pTarget = Target();
	const QPoint middle(
	    m_pOperator->Property("scene", "width").toInt() / 2, m_pOperator->Property("scene", "height").toInt() / 2);
	m_pOperator->AnswerNextDialog(File("sway.bvh"));
	m_pOperator->Key(Qt::Key_T, Qt::ControlModifier);
	EXPECT_EVENTUALLY(Player().Take() && Player().IsShown());
	ASSERT_EQ(Player().Frames(), c_Frames);
	ExpectNumbersOfTheCommandLine("hero.qrr");

	Press("TakePlay");
	EXPECT_EVENTUALLY(Player().Picture()->m_Frame > 3);
	const auto selection = [this] { return m_pWindow->Context().GetSelectionManager()->Selection().Items(); };
	const auto selected = selection();
	ASSERT_FALSE(selected.empty());
	// The view has the keyboard, and picks nothing.
	m_pOperator->ClickAt(middle);
	m_pOperator->Key(Qt::Key_Space);
	EXPECT_EVENTUALLY(!Player().IsPlaying());
	const std::size_t paused = Player().Frame();
	m_pOperator->Key(Qt::Key_Right);
	EXPECT_EQ(Player().Frame(), std::min(paused + 1, c_Frames - 1));
	EXPECT_EVENTUALLY(Player().AtRest());
	m_pOperator->WaitForDrawing();
	const QImage moved = m_pOperator->See(middle, 150);
	EXPECT_EQ(selection(), selected);

	auto& rTimeLine = Widget<StudioHost::VTimeLine>("TimeLine");
	QTest::mouseClick(&rTimeLine, Qt::LeftButton, {}, {rTimeLine.PlaceOf(15), 10});
	EXPECT_NEAR(double(Player().Frame()), 15.0, 1.0);
	Press("TakeIn");
	const std::size_t in = Player().In();
	m_pOperator->Key(Qt::Key_Left);
	EXPECT_EQ(Player().Frame(), in) << "held in the range, by the keys of the dock";
	m_pOperator->Key(Qt::Key_Right);
	EXPECT_EQ(Player().Frame(), in + 1);
	auto& rTable = Widget<QTableView>("TakeTargets");
	const QModelIndex worst = rTable.model()->index(1, rTable.model()->columnCount() - 1);
	rTable.scrollTo(worst);
	QTest::mouseClick(rTable.viewport(), Qt::LeftButton, {}, rTable.visualRect(worst).center());
	EXPECT_EQ(QString::number(Player().Frame()), worst.data().toString());
	EXPECT_EQ(Target(), pTarget) << "nothing of it is in the document";

	const auto& rSelection = m_pWindow->Context().GetSelectionManager()->Selection();
	ASSERT_EQ(rSelection.ItemsOfKind(NVX::ESelectionTarget).size(), 1u) << "chosen in the panel's list, too";
	EXPECT_EQ(rSelection.ItemsOfKind(NVX::ESelectionTarget)[0].m_ElementIndex, 1u);
	m_pOperator->ClickRow("targets", 0);
	EXPECT_EVENTUALLY(rTable.selectionModel()->isRowSelected(0, {}) && !rTable.selectionModel()->isRowSelected(1, {}));
	auto& rPlot = Widget<StudioHost::VResidualPlot>("ResidualPlot");
	QTest::mouseClick(rPlot.Canvas(), Qt::LeftButton, {}, {rPlot.PlaceOf(40.0), 3});
	EXPECT_NEAR(double(Player().Frame()), 40.0, 1.0);
	m_pOperator->Key(Qt::Key_End);
	EXPECT_EQ(Player().Frame(), Player().Out());
	EXPECT_EVENTUALLY(Player().AtRest());
	m_pOperator->WaitForDrawing();
	const QImage alone = m_pOperator->See(middle, 150);
	const auto clickGhost = [this] { QTest::mouseClick(&Widget<QCheckBox>("TakeGhost"), Qt::LeftButton, {}, {8, 8}); };
	clickGhost();
	EXPECT_EVENTUALLY(m_pOperator->See(middle, 150) != alone);
	clickGhost();
	EXPECT_EVENTUALLY(m_pOperator->See(middle, 150) == alone) << "and goes";

	// An edit is solved at once; numbers are those of what stands now.
	m_pOperator->ClickRow("targets", 1);
	m_pOperator->Fill("TargetWeight", "50");
	EXPECT_EVENTUALLY(Target() != pTarget);
	m_pWindow->RetargetPanel()->SaveTo(File("edited.qrr"));
	ExpectNumbersOfTheCommandLine("edited.qrr");

	m_pOperator->AnswerNextDialog(File("hero.bvh"));
	Press("TakeExport");
	TakeIO::VTake written;
	std::string error;
	EXPECT_EVENTUALLY(TakeIO::ReadTake(File("hero.bvh").toStdString(), {}, written, error));
	EXPECT_EQ(written.m_Frames, c_Frames - in);
	EXPECT_EQ(written.m_Joints.size(), Target()->m_Segments.size());

	EXPECT_EVENTUALLY(Widget<QToolButton>("TakeExport").isEnabled());
	m_pOperator->AnswerNextDialog(File("hero.glb"));
	Press("TakeExport");
	EXPECT_TRUE(Widget<QLabel>("TakeFile").text().contains("Choose its FBX file")) << "a skin is missing";
	EXPECT_FALSE(QFile::exists(File("hero.glb")));
	m_pWindow->Open(File("character.fbx"));
	for (const char* const pName : {"hero.glb", "hero.fbx"})
	{
		EXPECT_EVENTUALLY(Widget<QToolButton>("TakeExport").isEnabled());
		m_pOperator->AnswerNextDialog(File(pName));
		Press("TakeExport");
		EXPECT_EVENTUALLY(QFile::exists(File(pName))) << Widget<QLabel>("TakeFile").text().toStdString();
	}
	QFile binary(File("hero.glb"));
	ASSERT_TRUE(binary.open(QIODevice::ReadOnly));
	const QByteArray bytes = binary.readAll();
	EXPECT_TRUE(bytes.startsWith("glTF") && bytes.contains("\"animations\"") && bytes.contains("\"skins\""));
	TakeIO::VTakeSettings ofSway;
	ofSway.m_Stack = "sway";
	ofSway.m_Rate = 30.0;
	EXPECT_TRUE(TakeIO::ReadTake(File("hero.fbx").toStdString(), ofSway, written, error)) << error;
	EXPECT_EQ(written.m_Frames, c_Frames - in);
	// It is a character's file, too; as a take it is opened as one again.
	m_pWindow->OpenTake(File("hero.fbx"));
	EXPECT_EVENTUALLY(Player().Path() == File("hero.fbx") && Player().AtRest());
	m_pWindow->OpenTake(File("sway.bvh"));
	EXPECT_EVENTUALLY(Player().Path() == File("sway.bvh") && Player().AtRest());
	const QList<QAction*> recent = m_pWindow->findChild<QMenu*>("RecentMenu")->actions();
	ASSERT_TRUE(recent.value(1) && recent[1]->text().endsWith("hero.fbx (take)"));
	recent[1]->trigger();
	EXPECT_EVENTUALLY(Player().Path() == File("hero.fbx") && Player().AtRest());
	m_pWindow->OpenTake(File("sway.bvh"));
	EXPECT_EVENTUALLY(Player().Path() == File("sway.bvh") && Player().AtRest());

	Press("TakeStop");
	m_pOperator->WaitForDrawing();
	EXPECT_NE(m_pOperator->See(middle, 150), moved);
	m_pOperator->ClickAt({m_pOperator->Property("scene", "width").toDouble() - 3.0, 3.0});
	EXPECT_EVENTUALLY(selection() != selected);
}

TEST_F(Motion, TheViewGoesAlongWithWhatIsSelected)
{
	m_pWindow->OpenTake(File("sway.bvh"));
	EXPECT_EVENTUALLY(Player().Take() && Player().AtRest());
	const auto& rFollow = *m_pWindow->findChild<QAction*>("FollowSelected");
	const QPoint corner(60, m_pOperator->Property("scene", "height").toInt() - 60);
	const auto floorAt = [&](std::size_t i_Frame)
	{
		Player().Seek(std::int64_t(i_Frame));
		EXPECT_EVENTUALLY(Player().AtRest());
		m_pOperator->WaitForDrawing();
		return m_pOperator->See(corner, 45);
	};
	const auto press = [this] { m_pOperator->Key(Qt::Key_L, Qt::ControlModifier); };
	m_pWindow->Context().GetSelectionManager()->Selection().Replace({});
	press();
	EXPECT_FALSE(rFollow.isChecked()) << "nothing is selected";
	EXPECT_EQ(floorAt(0), floorAt(15));

	m_pOperator->ClickRow("targetSegments", RowOf("targetSegments", "skull"));
	press();
	ASSERT_TRUE(rFollow.isChecked());
	m_pOperator->WaitForDrawing();
	m_pWindow->Context().GetSelectionManager()->Selection().Replace({});
	const QImage first = floorAt(0);
	const QImage swayed = floorAt(15);
	EXPECT_NE(swayed, first) << "what was selected then moves, and the view with it";
	press();
	EXPECT_FALSE(rFollow.isChecked());
	EXPECT_EQ(floorAt(0), swayed) << "it stays where it is";
}

TEST_F(Motion, WhatCannotBeReadLeavesTheTakeBefore)
{
	m_pWindow->OpenTake(File("sway.bvh"), 20);
	EXPECT_EVENTUALLY(Player().Take() && Player().AtRest());
	EXPECT_EQ(Player().Frame(), 20u);
	const auto pTake = Player().Take();
	m_pWindow->OpenTake(File("character.fbx.not-there"));
	EXPECT_TRUE(Player().IsReading());
	EXPECT_EVENTUALLY(!Player().IsReading() && Player().AtRest());
	EXPECT_EQ(Player().Take(), pTake);
	ASSERT_TRUE(Player().Judged()) << "judged again";
	m_pWindow->OpenTake(File("sway.bvh"));
	Press("TakeCancel");
	EXPECT_FALSE(Player().IsReading());
	EXPECT_EVENTUALLY(Player().AtRest());
	EXPECT_EQ(Player().Take(), pTake) << "what was being read is not told of";
	Press("TakeClose");
	EXPECT_FALSE(Player().IsShown() || Player().Take());
}

TEST_F(Window, PlaysAPerformerThatIsMadeOfTheTake)
{
	m_pWindow->OpenTake(RETARGET_SOURCE "/demo/walk.bvh", 100);
	EXPECT_EVENTUALLY(m_pWindow->Motion().Take() && m_pWindow->Motion().AtRest());
	EXPECT_TRUE(m_pWindow->Motion().IsPerformerMade());
	auto* const pMake = m_pWindow->findChild<QToolButton*>("TakeMakePerformer");
	ASSERT_TRUE(pMake && pMake->isVisible());
	m_pOperator->AnswerNextDialog(File("made.qrs"));
	QTest::mouseClick(pMake, Qt::LeftButton);
	EXPECT_EVENTUALLY(m_pOperator->Property("sourceSegments", "count").toInt() > 20);
	EXPECT_EVENTUALLY(!pMake->isVisible());
	EXPECT_TRUE(m_pWindow->Motion().IsShown()) << "and goes on";
	EXPECT_EQ(Run({"check", File("made.qrs"), "--strict"}), "no findings\n");
}

} // namespace
