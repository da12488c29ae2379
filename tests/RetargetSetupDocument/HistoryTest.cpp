// Undo and Redo: what they bring back, what is one step, and that going back and forth leaves no trace in a file.

#include "TestDocument.h"

#include "RetargetSetupCore/StepNames.h"

#include <functional>
#include <random>

namespace
{

using CoreOrlexTypes::VSubjectParametrised;
using NVX::ISelectionItem;

class History : public VDocumentTest
{
protected:
	History() { m_Document.KeepHistory(m_Host.GetSelectionManager()); }

	/// The names of all that can be undone, the next first; all of it is done again.
	std::string Names()
	{
		std::string names;
		int count = 0;
		for (; !m_Document.UndoName().isEmpty(); ++count)
		{
			names += m_Document.UndoName().toStdString() + ";";
			m_Document.Undo();
		}
		while (count-- > 0)
			m_Document.Redo();
		return names;
	}

	static void Pose(VRetargetSetup& io_rDocument, double i_Angle, const RetargetSetup::VEdit& i_rEdit = {})
	{
		VSubjectParametrised subject;
		if (!io_rDocument.GetTargetSubject(subject))
			return;
		VSubjectParametrised::VJoint& rJoint = subject.m_Segments[0].m_Joint;
		rJoint.m_BindPose.at(0) = i_Angle;
		rJoint.m_Mean = rJoint.m_BindPose;
		io_rDocument.SetTargetSubjectParametrised(std::move(subject), i_rEdit);
	}
};

TEST_F(History, EachEditComesBackUnderItsName)
{
	ASSERT_TRUE(m_Document.LoadTargetFBX(RETARGET_SOURCE "/demo/character.fbx"));
	ASSERT_TRUE(m_Document.LoadSourceSubject(RETARGET_SOURCE "/demo/performer.qrs", ""));
	const struct
	{
		const char* m_pName;
		std::function<void()> m_Edit;
	} rows[] = {{"Create Target Subject", [&] { m_Document.CreateTargetSubject(); }},
	    {"Add Target", [&] { m_Document.AddTarget(0, 0, true, false); }},
	    {"Add Target", [&] { m_Document.AddTarget(1, 1, false, true); }},
	    {"Remove Joint", [&] { m_Document.RemoveJoint(1); }},
	    {"Remove Unnecessary Joints", [&] { m_Document.RemoveUnnecessaryJoints(); }},
	    {"Create All Joints", [&] { m_Document.CreateAllJoints(); }},
	    {"Pose Segment", [&] { Pose(m_Document, 0.5, {RetargetSetup::Steps::c_Pose}); }},
	    {"Update Targets", [&] { m_Document.UpdateTargets(); }},
	    {"Take Pose from FBX", [&] { m_Document.MatchFilePose(); }},
	    {"Change Scale", [&] { m_Document.SetTargetScale(2.0); }},
	    {"Scale Root Height", [&] { m_Document.SetScaleRootHeight(true); }},
	    {"Remove Target", [&] { m_Document.RemoveTarget(0); }},
	    {"New Retarget Subject", [&] { m_Document.NewTargetSubject(); }},
	    {"Load",
	        [&]
	        {
		        Put(m_Folder / "a.qrr", Get(RETARGET_SOURCE "/demo/performer.qrs"));
		        m_Document.LoadTargetSubjectURL(Url("a.qrr"));
	        }}};
	std::vector<VRetargetSetup::VSubjectValues> states{m_Document.TargetValues()};
	std::vector<std::uint64_t> numbers{m_Document.TargetIdentity(0)};
	std::string names;
	for (const auto& rRow : rows)
	{
		rRow.m_Edit();
		names = rRow.m_pName + (";" + names);
		states.push_back(m_Document.TargetValues());
		numbers.push_back(m_Document.TargetIdentity(0));
		EXPECT_EQ(m_Document.UndoName(), rRow.m_pName);
	}
	EXPECT_EQ(Names(), names);
	const auto expect = [&](std::size_t i_State)
	{
		const auto now = m_Document.TargetValues();
		EXPECT_EQ(now.m_pParametrised, states[i_State].m_pParametrised) << "the value itself, no copy";
		EXPECT_EQ(now.m_pSubject, states[i_State].m_pSubject);
		EXPECT_EQ(now.m_pApplicationData, states[i_State].m_pApplicationData);
		EXPECT_EQ(m_Document.TargetIdentity(0), numbers[i_State]);
		EXPECT_EQ(m_Document.ScaleRootHeight(), i_State >= 11);
	};
	for (std::size_t i = std::size(rows); i-- > 0;)
	{
		SCOPED_TRACE(rows[i].m_pName);
		m_Document.Undo();
		expect(i);
		m_Document.Redo();
		expect(i + 1);
		EXPECT_EQ(m_Document.RedoName(), i + 1 < std::size(rows) ? rows[i + 1].m_pName : "");
		m_Document.Undo();
	}
	m_Changes = 0;
	QString reason;
	QObject::connect(&m_Document, &VRetargetSetup::commandIgnored,
	    [&](const QString& i_rCommand, const QString& i_rReason) { reason = i_rCommand + ": " + i_rReason; });
	m_Document.Undo();
	EXPECT_EQ(reason, "Undo: There is nothing to undo.");
	VRetargetSetup plain(m_Host.GetDispatcher(), m_Host.GetFrameFactory(), m_Host.GetItemFactory());
	plain.SetTargetSubject(*states[1].m_pParametrised, *states[1].m_pApplicationData);
	plain.RemoveUnnecessaryJoints();
	EXPECT_EQ(plain.UndoName(), "") << "nobody has asked for it";
	EXPECT_EQ(m_Changes, 0);
}

TEST_F(History, OneWayIsOneStep)
{
	SetSmallSubjects();
	m_Document.AddTarget(1, 1, true, false);
	m_Document.UpdateTargets();
	EXPECT_EQ(m_Document.UndoName(), "Add Target") << "an edit that changes nothing is none";
	m_Document.AddTarget(2, 2, true, false);
	m_Document.Undo();
	const VSubjectParametrised before = Target();
	const auto drag = [&](std::initializer_list<double> i_Angles, std::uint64_t i_Way)
	{
		for (const double angle : i_Angles)
			Pose(m_Document, angle, {RetargetSetup::Steps::c_Pose, i_Way});
	};
	drag({0.1, 0.2, 0.0}, 1);
	EXPECT_EQ(m_Document.RedoName(), "");
	m_Document.EndStep();
	EXPECT_EQ(Target(), before);
	EXPECT_EQ(m_Document.UndoName(), "Add Target") << "a drag that came back is none";
	EXPECT_EQ(m_Document.RedoName(), "Add Target") << "and what was undone before it can be done again";
	drag({0.1, 0.2, 0.3}, 2);
	drag({0.4, 0.5}, 3);
	m_Document.EndStep();
	drag({0.6, 0.7}, 3);
	EXPECT_EQ(Names(), "Pose Segment;Pose Segment;Pose Segment;Add Target;Edit;");
	const double angles[] = {0.5, 0.3, 0.0};
	for (const double angle : angles)
	{
		m_Document.Undo();
		EXPECT_EQ(Target().m_Segments[0].m_Joint.m_BindPose[0], angle);
	}
	EXPECT_EQ(Target(), before);
	// Whoever is in the middle of an edit ends it.
	drag({0.8}, 4);
	m_Document.GetLeavingSignal().Connect([&] { drag({0.9}, 4); });
	m_Document.Undo();
	EXPECT_EQ(Target(), before);
}

TEST_F(History, FileSavedMarkAndSelectionComeBack)
{
	SetSmallSubjects();
	auto& rSelection = m_Host.GetSelectionManager()->Selection();
	const ISelectionItem other{14, 7, 3, "of another subject"};
	const ISelectionItem hand{14, 0x0FFFFFFF, 3, {}}, target{16, 0x0FFFFFFF, 0, {}};
	QUrl file;
	for (const auto signal : {&VRetargetSetup::targetSubjectLoaded, &VRetargetSetup::targetSubjectSaved,
	         &VRetargetSetup::targetSubjectBroughtBack})
		QObject::connect(&m_Document, signal, [&](const QUrl& i_rUrl) { file = i_rUrl; });

	rSelection.Replace({hand});
	m_Document.AddTarget(1, 1, true, false);
	m_Document.SaveTargetSubjectURL(Url("a.qrr"));
	rSelection.Replace({other, target});
	m_Document.RemoveTarget(0);
	rSelection.Replace({other});
	m_Document.SaveTargetSubjectURL(Url("b.qrr"));
	EXPECT_FALSE(m_Document.HasUnsavedChanges());
	m_Document.LoadTargetSubjectURL(Url("a.qrr"));
	m_Document.AddTarget(2, 2, true, false);
	m_Document.SaveTargetSubjectURL(Url("a.qrr"));
	const struct
	{
		const char* m_pUndone;
		const char* m_pFile;
		bool m_bUnsaved;
		std::vector<ISelectionItem> m_Selected;
	} rows[] = {{"Add Target", "a.qrr", true, {other}}, {"Load", "b.qrr", false, {other}},
	    {"Remove Target", "b.qrr", true, {target, other}}, {"Add Target", "b.qrr", false, {hand, other}}};
	for (const auto& rRow : rows)
	{
		EXPECT_EQ(m_Document.UndoName(), rRow.m_pUndone);
		m_Document.Undo();
		EXPECT_EQ(file, Url(rRow.m_pFile));
		EXPECT_EQ(m_Document.HasUnsavedChanges(), rRow.m_bUnsaved);
		m_Host.Dispatcher().RunPending();
		EXPECT_EQ(rSelection.Items(), rRow.m_Selected);
	}
	for (const char* const pFile : {"b.qrr", "b.qrr", "a.qrr", "a.qrr"})
	{
		m_Document.Redo();
		EXPECT_EQ(file, Url(pFile));
	}
	EXPECT_FALSE(m_Document.HasUnsavedChanges()) << "as it was saved";
	// What a later subject writes to it is no longer what this one has saved there.
	m_Document.SaveTargetSubjectURL(Url("b.qrr"));
	m_Document.Undo();
	m_Document.Undo();
	EXPECT_EQ(file, Url("b.qrr"));
	EXPECT_TRUE(m_Document.HasUnsavedChanges());
	m_Document.RestoreTargetSubject(m_Folder / "a.qrr", m_Folder / "c.qrr");
	EXPECT_EQ(m_Document.UndoName() + m_Document.RedoName(), "") << "what was taken up again is not lost by an undo";
}

TEST_F(History, OldStepsGoWhereTheyTakeTooMuch)
{
	m_Document.KeepHistory(nullptr, 100'000);
	SetSmallSubjects();
	NVX::GlobalLog::Category("RetargetSetup").SetLevel(NVX::ELogInformation);
	VLogRecorder log;
	for (int i = 0; i < 200; ++i)
		Pose(m_Document, 0.01 * i + 0.01);
	const std::string names = Names();
	const auto count = std::count(names.begin(), names.end(), ';');
	EXPECT_GT(count, 2);
	EXPECT_LT(count, 30) << "five segments take some thousand bytes";
	NVX::GlobalLog::Category("RetargetSetup").SetLevel(NVX::ELogWarning);
	const std::string told = log.Take();
	const std::string c_Told = "The oldest edits can no longer be undone: what is kept for that has reached 0 MiB";
	EXPECT_EQ(told.find(c_Told), told.rfind(c_Told));
	EXPECT_NE(told.find(c_Told), std::string::npos);
}

/// One edit of the target subject; the same on the same state.
using VOperation = std::function<void(VRetargetSetup&)>;

TEST_F(History, AnyOrderOfEditUndoRedoAndSaveGivesTheFileOfTheEditsAlone)
{
	const boost::filesystem::path saved = m_Folder / "saved.qrr";
	const auto begin = [](VRetargetSetup& io_rDocument)
	{
		ASSERT_TRUE(io_rDocument.LoadTargetFBX(RETARGET_SOURCE "/demo/character.fbx"));
		ASSERT_TRUE(io_rDocument.LoadSourceSubject(RETARGET_SOURCE "/demo/performer.qrs", ""));
	};
	// A file that holds more than a subject.
	Put(m_Folder / "other.qrr", Get(RETARGET_TEST_DATA "/qrt/version-3.5.qrs"));
	m_Document.LoadTargetSubject(m_Folder / "other.qrr");
	ASSERT_FALSE(m_Document.GetTargetExtras() == CoreOrlexQRTIO::VSubjectQRTExtras());
	for (unsigned seed = 1; seed <= 5; ++seed)
	{
		SCOPED_TRACE(seed);
		std::mt19937 random(seed);
		const auto upTo = [&random](int i_Most) { return int(random() % unsigned(i_Most + 1)); };
		VRetargetSetup document(m_Host.GetDispatcher(), m_Host.GetFrameFactory(), m_Host.GetItemFactory());
		document.KeepHistory(m_Host.GetSelectionManager());
		begin(document);
		std::vector<VOperation> done, undone;
		const auto operation = [&]() -> VOperation
		{
			const int a = upTo(30), b = upTo(30), way = upTo(1000);
			switch (document.TargetValues().m_pParametrised ? upTo(12) : 12)
			{
			case 0: return [](VRetargetSetup& io_rDocument) { io_rDocument.UpdateTargets(); };
			case 1: return [](VRetargetSetup& io_rDocument) { io_rDocument.RemoveUnnecessaryJoints(); };
			case 2: return [](VRetargetSetup& io_rDocument) { io_rDocument.CreateAllJoints(); };
			case 3: return [a](VRetargetSetup& io_rDocument) { io_rDocument.SetTargetScale(0.5 + 0.1 * a); };
			case 4:
				return [](VRetargetSetup& io_rDocument)
				{ io_rDocument.SetScaleRootHeight(!io_rDocument.ScaleRootHeight()); };
			case 5:
				return [this](VRetargetSetup& io_rDocument) { io_rDocument.LoadTargetSubject(m_Folder / "other.qrr"); };
			case 6: return [a](VRetargetSetup& io_rDocument) { io_rDocument.RemoveTarget(a % 4); };
			case 7: return [](VRetargetSetup& io_rDocument) { io_rDocument.NewTargetSubject(); };
			case 8:
			case 9:
				return [a, way](VRetargetSetup& io_rDocument)
				{
					for (int i = 0; i <= a; ++i)
						Pose(io_rDocument, 0.01 * (way + i), {RetargetSetup::Steps::c_Pose, std::uint64_t(way) + 1});
					io_rDocument.EndStep();
				};
			case 12: return [](VRetargetSetup& io_rDocument) { io_rDocument.CreateTargetSubject(); };
			default:
				return [a, b](VRetargetSetup& io_rDocument) { io_rDocument.AddTarget(a, b, a % 2 == 0, b % 2 == 0); };
			}
		};
		for (int step = 0; step < 50; ++step)
		{
			const int what = upTo(9);
			if (what <= 3)
			{
				const QString undoBefore = document.UndoName();
				const auto before = document.TargetValues();
				const bool bFlag = document.ScaleRootHeight();
				const VOperation edit = operation();
				const std::uint64_t number = document.TargetSubjectIdentity();
				edit(document);
				const auto now = document.TargetValues();
				if (number == document.TargetSubjectIdentity() && bFlag == document.ScaleRootHeight()
				    && now.m_pParametrised && *now.m_pParametrised == *before.m_pParametrised)
					continue;
				done.push_back(edit);
				undone.clear();
			}
			else if (what <= 6 && !done.empty())
			{
				document.Undo();
				undone.push_back(done.back());
				done.pop_back();
			}
			else if (what <= 8 && !undone.empty())
			{
				document.Redo();
				done.push_back(undone.back());
				undone.pop_back();
			}
			else if (document.TargetValues().m_pParametrised)
			{
				ASSERT_EQ(document.SaveTargetSubject(saved), 0u);
				EXPECT_FALSE(document.HasUnsavedChanges());
				VRetargetSetup plain(m_Host.GetDispatcher(), m_Host.GetFrameFactory(), m_Host.GetItemFactory());
				begin(plain);
				for (const VOperation& rEdit : done)
					rEdit(plain);
				ASSERT_EQ(plain.SaveTargetSubject(m_Folder / "plain.qrr"), 0u);
				EXPECT_TRUE(Get(saved) == Get(m_Folder / "plain.qrr")) << "step " << step;
			}
			EXPECT_EQ(document.UndoName().isEmpty(), done.empty()) << "step " << step;
			EXPECT_EQ(document.RedoName().isEmpty(), undone.empty()) << "step " << step;
			m_Host.Dispatcher().RunPending();
		}
	}
}

} // namespace
