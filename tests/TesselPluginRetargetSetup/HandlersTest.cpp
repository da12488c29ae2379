// Parameters and document follow each other, and neither hears its own echo.

#include "../WaitFor.h"
#include "TestPanel.h"

#include "OrlexGraphics/skins/SkinCache.h"
#include "TesselDataStore/StoredValue.h"
#include "TesselPluginRetargetSetup/FollowedFile.h"

#include <QTest>

#include <fstream>
#include <limits>

namespace
{

namespace fs = boost::filesystem;
using CoreOrlexTypes::VSubjectParametrised;
using TesselDataStore::ToVariant;
using TesselPluginInterface::IParameter;

class Handlers : public VPanelTest
{
protected:
	/// The demo with a position target, a rotation target and another position target.
	void OpenWithTargets()
	{
		OpenDemo();
		m_pDocument->CreateTargetSubject();
		m_pDocument->AddTarget(0, 0, true, false);
		m_pDocument->AddTarget(1, 1, false, false);
		m_pDocument->AddTarget(2, 2, true, false);
		VSubjectParametrised subject = Target();
		subject.m_Targets[0].m_StateExpressions = {"0.5*GlobalScale", "-2", "GlobalScale"};
		subject.m_Targets[0].m_Weight = 0.5;
		m_pDocument->SetTargetSubjectParametrised(subject);
		Run();
		m_pDocument->GetChangedSignal().Connect([this] { ++m_Changes; });
		TakeLog();
	}

	std::vector<std::string> Shown() const
	{
		return {Text("TargetWeight"), Text("TargetStateExpressionX"), Text("TargetStateExpressionY"),
		    Text("TargetStateExpressionZ")};
	}

	std::vector<std::vector<std::string>> States() const
	{
		std::vector<std::vector<std::string>> states;
		for (const VSubjectParametrised::VTarget& rTarget : Target().m_Targets)
			states.push_back(rTarget.m_StateExpressions);
		return states;
	}

	fs::path Copy(const std::string& i_rFrom, const std::string& i_rTo) const
	{
		fs::create_directories((m_Folder / i_rTo).parent_path());
		fs::copy_file(i_rFrom, m_Folder / i_rTo);
		return m_Folder / i_rTo;
	}

	int m_Changes = 0;
};

TEST_F(Handlers, ShowingATargetRewritesNothing)
{
	OpenWithTargets();
	const auto pBefore = m_pDocument->TargetValues().m_pParametrised;
	Select(NVX::ESelectionTarget, 0);
	EXPECT_EQ(Shown(), (std::vector<std::string>{"0.5", "0.5", "-2", "1"})) << "numbers, and a weight below the limit";
	Select(NVX::ESelectionTarget, 1);
	Select(NVX::ESelectionTarget, 2);
	Select(NVX::ESelectionTarget, 0);
	m_Context.SelectionManager().Selection().Replace({});
	Run();
	EXPECT_EQ(m_Changes, 0);
	EXPECT_EQ(m_pDocument->TargetValues().m_pParametrised, pBefore);

	VSubjectParametrised subject = Target();
	subject.m_DynamicParameters[0].m_Value = 2.0;
	subject.m_Targets[0].m_StateExpressions = {"12.25*GlobalScale", "nonsense(", "0.1"};
	m_pDocument->SetTargetSubjectParametrised(subject);
	Select(NVX::ESelectionTarget, 0);
	EXPECT_EQ(Shown(), (std::vector<std::string>{"0.5", "24.5", "0", "0.10000000000000001"}));
	EXPECT_EQ(Target(), subject);
}

TEST_F(Handlers, StatesAreHiddenForRotationsOnly)
{
	OpenWithTargets();
	for (const auto& [index, bHidden] : {std::pair<int, bool>{1, true}, {0, false}, {1, true}, {2, false}})
	{
		Select(NVX::ESelectionTarget, std::uint32_t(index));
		for (const char* const pKey : {"TargetStateExpressionX", "TargetStateExpressionY", "TargetStateExpressionZ"})
			EXPECT_EQ(Parameter(pKey).GetFlags(), bHidden ? std::uint32_t(IParameter::EHidden) : 0u) << index << pKey;
		EXPECT_EQ(Parameter("TargetWeight").GetFlags(), 0u);
	}
}

TEST_F(Handlers, OnlyWhatIsTypedReachesTheTarget)
{
	OpenWithTargets();
	Select(NVX::ESelectionTarget, 0);
	EXPECT_EQ(Type("TargetWeight", "20"), "");
	EXPECT_EQ(Target().m_Targets[0].m_Weight, 20.0);
	EXPECT_EQ(
	    Target().m_Targets[0].m_StateExpressions, (std::vector<std::string>{"0.5*GlobalScale", "-2", "GlobalScale"}));
	EXPECT_EQ(Target().m_Targets[2].m_Weight, 1.0);
	EXPECT_EQ(m_Changes, 1);

	EXPECT_EQ(Type("TargetStateExpressionY", "7.25"), "");
	EXPECT_EQ(Target().m_Targets[0].m_StateExpressions,
	    (std::vector<std::string>{"0.5*GlobalScale", "7.250000*GlobalScale", "GlobalScale"}));
	EXPECT_EQ(m_Changes, 2);

	EXPECT_NE(Type("TargetWeight", "0.5"), "") << "an operator cannot type what a file may hold";
	EXPECT_EQ(m_Changes, 2);
	EXPECT_EQ(TakeLog(), "");
}

TEST_F(Handlers, WhatIsSavedHoldsWhatWasJustTyped)
{
	OpenWithTargets();
	Select(NVX::ESelectionTarget, 0);
	EXPECT_EQ(Parameter("TargetWeight").SetValueText("30"), "");
	EXPECT_EQ(Parameter("TargetScale").SetValueText("2"), "");
	m_pWidget->ApplyParameters();
	EXPECT_EQ(Target().m_Targets[0].m_Weight, 30.0);
	EXPECT_EQ(m_pDocument->GetTargetScale(), 2.0);
	Run();
	EXPECT_EQ(m_Changes, 2) << "and is not applied again";
	auto& rSelection = m_Context.SelectionManager().Selection();
	rSelection.Remove(rSelection.ItemsOfKind(NVX::ESelectionTarget));
	m_pWidget->ApplyParameters();
	EXPECT_EQ(m_pSelection->SelectedTarget(), -1) << "nor is a command for what is selected no more";
}

TEST_F(Handlers, WhatTheDocumentRefusesIsShownAsItIsAgain)
{
	OpenWithTargets();
	Select(NVX::ESelectionTarget, 0);
	EXPECT_EQ(Type("TargetStateExpressionX", "twelve"), "");
	EXPECT_NE(TakeLog().find("State X of target 0 stays as it was"), std::string::npos);
	EXPECT_EQ(Text("TargetStateExpressionX"), "0.5");
	EXPECT_EQ(Target().m_Targets[0].m_StateExpressions[0], "0.5*GlobalScale");
}

TEST_F(Handlers, NoStaleNumberIsWrittenBackAfterTheDocumentMoved)
{
	OpenWithTargets();
	Select(NVX::ESelectionTarget, 0);
	m_pDocument->UpdateTargets();
	Run();
	EXPECT_EQ(Shown()[1], "0");
	const auto afterUpdate = States();
	m_pDocument->SetTargetScale(2.0);
	Run();
	EXPECT_NE(TakeLog().find("the root keeps its height"), std::string::npos);
	EXPECT_EQ(Text("TargetScale"), "2");
	EXPECT_EQ(States(), afterUpdate);
	m_pDocument->RemoveTarget(0);
	Run();
	ASSERT_EQ(Target().m_Targets.size(), 2u);
	EXPECT_EQ(States()[0], afterUpdate[1]) << "the next one has taken the selected place";
	EXPECT_EQ(m_pSelection->SelectedTarget(), 0);
	EXPECT_TRUE(Parameter("TargetStateExpressionX").GetFlags() & IParameter::EHidden);

	Select(NVX::ESelectionTarget, 1);
	EXPECT_EQ(Parameter("TargetWeight").SetValueText("9"), "");
	m_pDocument->RemoveTarget(1);
	Run();
	EXPECT_EQ(Target().m_Targets.at(0).m_Weight, 1.0) << "what was typed goes with its target";
	const std::string log = TakeLog();
	EXPECT_NE(log.find("which is gone: it is dropped"), std::string::npos) << log;
}

TEST_F(Handlers, WhatIsTypedReachesWhatItWasTypedFor)
{
	OpenWithTargets();
	Select(NVX::ESelectionTarget, 2);
	EXPECT_EQ(Parameter("TargetWeight").SetValueText("9"), "");
	m_pDocument->RemoveTarget(0);
	Run();
	EXPECT_EQ(Target().m_Targets.at(1).m_Weight, 9.0) << "where it stands now";
	EXPECT_EQ(TakeLog(), "");

	const std::string file = (m_Folder / "a.qrr").string();
	ASSERT_EQ(m_pDocument->SaveTargetSubject(file), 0u);
	Select(NVX::ESelectionTarget, 0);
	TakeLog();
	EXPECT_EQ(Parameter("TargetWeight").SetValueText("11"), "");
	EXPECT_EQ(Parameter("TargetScale").SetValueText("3"), "");
	ASSERT_EQ(m_pDocument->LoadTargetSubject(file), 0u);
	Run();
	EXPECT_EQ(m_pSelection->SelectedTarget(), -1) << "of the subject before";
	EXPECT_EQ(Target().m_Targets.at(0).m_Weight, 1.0);
	EXPECT_EQ(m_pDocument->GetTargetScale(), 1.0);
	EXPECT_EQ(Text("TargetScale"), "1");
	const std::string log = TakeLog();
	EXPECT_NE(log.find("The scale 3 was typed for another target subject"), std::string::npos) << log;
	EXPECT_NE(log.find("which is gone: it is dropped"), std::string::npos) << log;

	// The document changes between the typing and its being heard of.
	Select(NVX::ESelectionTarget, 0);
	m_pDocument->RemoveUnnecessaryJoints();
	EXPECT_EQ(Parameter("TargetWeight").SetValueText("12"), "");
	EXPECT_EQ(Parameter("TargetScale").SetValueText("2"), "");
	Run();
	EXPECT_EQ(Target().m_Targets.at(0).m_Weight, 12.0);
	EXPECT_EQ(m_pDocument->GetTargetScale(), 2.0);
}

TEST_F(Handlers, SeveralRootBonesAreToldUnlessOneIsChosen)
{
	OpenDemo();
	m_Context.Folders().SetFolder("FolderSkins", RETARGET_TEST_DATA "/fbx/cases");
	Run();
	fs::copy_file(RETARGET_TEST_DATA "/fbx/cases/plain_parents.fbx", m_Folder / "other.fbx");
	EXPECT_EQ(Type("TargetFBX", "plain_parents"), "");
	for (const char* const pRoot : {"", "1", "0", "1", "another file"})
	{
		const bool bChosen = *pRoot == '0' || *pRoot == '1';
		if (bChosen)
			Type("TargetRoot", pRoot);
		else if (*pRoot)
			Parameter("TargetFBX").SetValue(ToVariant((m_Folder / "other.fbx").string()));
		Run();
		// As every button does first.
		m_pWidget->ApplyParameters();
		TakeLog();
		m_pDocument->CreateTargetSubject();
		EXPECT_EQ(TakeLog().find("root bones, and no root was chosen") != std::string::npos, !bChosen) << pRoot;
	}
}

TEST_F(Handlers, ScaleFollowsTheFileAndKeepsItsParameters)
{
	OpenWithTargets();
	VSubjectParametrised subject = Target();
	subject.m_DynamicParameters.push_back({"Age", 0, 0, 40, false});
	subject.m_DynamicParameters[0].m_Value = 1.5;
	m_pDocument->SetTargetSubjectParametrised(subject);
	Run();
	EXPECT_EQ(Text("TargetScale"), "1.5");
	EXPECT_EQ(Target().m_DynamicParameters.size(), 2u) << "showing the scale writes nothing";
	EXPECT_EQ(Type("TargetScale", "1.50"), "");
	EXPECT_EQ(Target().m_DynamicParameters.size(), 2u) << "nor does typing the same";
	EXPECT_EQ(TakeLog(), "");

	for (const double refused : {0.0, -1.0, std::numeric_limits<double>::infinity()})
	{
		Parameter("TargetScale").SetValue(ToVariant(refused));
		Run();
		EXPECT_EQ(Text("TargetScale"), "1.5") << refused;
		EXPECT_EQ(Target().m_DynamicParameters.size(), 2u);
		EXPECT_NE(TakeLog().find("A scale must be a finite number above 0"), std::string::npos);
	}

	m_pDocument->CreateTargetSubject();
	Run();
	EXPECT_EQ(m_pDocument->GetTargetScale(), 1.5) << "a new subject has the scale that is shown";
	EXPECT_EQ(Type("TargetScale", "2"), "");
	EXPECT_EQ(m_pDocument->GetTargetScale(), 2.0);
}

TEST_F(Handlers, ScaleIsLeftAloneWhileThereIsNoTarget)
{
	OpenDemo();
	EXPECT_EQ(Type("TargetScale", "3"), "");
	EXPECT_EQ(Type("SourceSkeleton", "performer"), "");
	EXPECT_EQ(Text("TargetScale"), "3");
	m_pDocument->CreateTargetSubject();
	Run();
	EXPECT_EQ(m_pDocument->GetTargetScale(), 3.0);
}

TEST_F(Handlers, AnFBXFileBringsItsBones)
{
	OpenDemo();
	const std::vector<TesselPluginInterface::VEnumEntry> bones = Parameter("TargetRoot").GetEnumeration();
	ASSERT_EQ(bones.size(), m_pDocument->GetFBXSkeleton()->size());
	EXPECT_EQ(bones[1].m_Name, " loin") << "below the haunch";
	EXPECT_EQ(bones.back().m_Name, "    clawRight") << "below thigh, shin and hock";
	EXPECT_EQ(bones[1].m_Value, ToVariant(std::uint32_t(1)));
	EXPECT_EQ(Text("TargetRoot"), "0");
	EXPECT_EQ(Type("TargetRoot", "1"), "");
	m_pDocument->CreateTargetSubject();
	Run();
	EXPECT_EQ(Target().m_Segments[0].m_Name, "loin");

	m_Context.Folders().SetFolder("FolderSkins", RETARGET_TEST_DATA "/fbx");
	Run();
	EXPECT_EQ(Type("TargetFBX", "heaps_biped_zup_a7100"), "");
	EXPECT_EQ(Text("TargetRoot"), "0");
	EXPECT_NE(Parameter("TargetRoot").GetEnumeration(), bones);
	EXPECT_EQ(Target().m_Segments[0].m_Name, "loin") << "nothing is built before the command";
	EXPECT_EQ(Type("TargetFBX", "(None)"), "");
	EXPECT_TRUE(m_pDocument->GetFBXSkeleton()) << "no choice ends the handler";
}

TEST_F(Handlers, AFileThatGivesNothingIsToldWhileItIsChosen)
{
	OpenDemo();
	std::ofstream((m_Folder / "broken.fbx").string()) << "no such thing";
	std::ofstream((m_Folder / "broken.qrs").string()) << "no such thing";
	const struct
	{
		const char* m_pParameter;
		std::string m_File;
		std::string m_Log;
		std::string m_Remarks;
	} rows[] = {
	    {"TargetFBX", (m_Folder / "broken.fbx").string(),
	        "gives no skeleton: File is not an FBX file. The one of 'character' stays",
	        "broken.fbx gives no skeleton: File is not an FBX file. Root and \"Create Target Subject\" are still "
	        "those of character."},
	    {"SourceSkeleton", (m_Folder / "broken.qrs").string(), "still showing 'performer'",
	        "broken.qrs cannot be read: the source is still performer.\nbroken.fbx gives no skeleton: File is not an "
	        "FBX "
	        "file. Root and \"Create Target Subject\" are still those of character."},
	    {"TargetFBX", RETARGET_TEST_DATA "/fbx/cases/no_skeleton.fbx",
	        "gives no skeleton: It holds no skeleton. There is none now",
	        "broken.qrs cannot be read: the source is still performer.\nno_skeleton.fbx gives no skeleton: It holds no "
	        "skeleton. There is nothing to create a target subject from."},
	    {"SourceSkeleton", c_DemoSource, "",
	        "no_skeleton.fbx gives no skeleton: It holds no skeleton. There is nothing to create a target subject "
	        "from."},
	    {"TargetFBX", c_DemoFBX, "", ""}};
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_File);
		TakeLog();
		Parameter(rRow.m_pParameter).SetValue(ToVariant(rRow.m_File));
		Run();
		const std::string log = TakeLog();
		EXPECT_NE(log.find(rRow.m_Log), std::string::npos) << log;
		EXPECT_EQ(m_pWidget->Remarks().toStdString(), rRow.m_Remarks);
		EXPECT_EQ(Parameter("TargetRoot").GetEnumeration().empty(), !m_pDocument->GetFBXSkeleton());
	}
	EXPECT_EQ(Property("remarks", "text").toString(), "");
	m_pDocument->CreateTargetSubject();
	m_pDocument->SetTargetScale(0.5);
	Run();
	Parameter("TargetFBX").SetValue(ToVariant(std::string(RETARGET_TEST_DATA "/fbx/heaps_biped_zup_a7100.fbx")));
	Run();
	TakeLog();
	EXPECT_EQ(m_pWidget->Remarks().toStdString(),
	    "The target subject is of character. FBX and root above are of heaps_biped_zup_a7100, for the next \"Create "
	    "Target Subject\".");
	m_pDocument->CreateTargetSubject();
	EXPECT_NE(TakeLog().find("'heaps_biped_zup_a7100' is made with the scale 0.5, which was that of 'character'"),
	    std::string::npos);
	Run();
	EXPECT_EQ(m_pWidget->Remarks().toStdString(), "");

	const auto& rBones = *m_pDocument->GetFBXSkeleton();
	for (const std::uint32_t root : {1u, 0u})
	{
		Parameter("TargetRoot").SetValue(ToVariant(root));
		Run();
		EXPECT_EQ(m_pWidget->Remarks().toStdString(),
		    root == 0 ? ""
		              : "The target subject begins at " + rBones[0].m_Name + ". The root above, " + rBones[1].m_Name
		            + ", is for the next \"Create Target Subject\".");
	}
}

TEST_F(Handlers, AnFBXFileThatChangesOnDiskIsReadAgain)
{
	const fs::path file = Copy(c_DemoFBX, "a.fbx");
	const std::string heaps = Get(RETARGET_TEST_DATA "/fbx/heaps_biped_zup_a7100.fbx");
	std::string moved = heaps;
	moved.replace(moved.find("-0.362284749746323"), 5, "-0.47");
	m_Context.Folders().SetFolder("FolderSkins", m_Folder / "");
	Open();
	EXPECT_EQ(Type("TargetFBX", "a"), "");
	EXPECT_EQ(Type("TargetRoot", "1"), "");
	m_pDocument->CreateTargetSubject();
	Run();
	const struct
	{
		std::string m_Content;
		const char* m_pChange;
		/// The same bone, or the first where it is gone.
		const char* m_pRoot;
	} rows[] = {{heaps, "'loin'", "0"}, {moved, "stand otherwise ('", "2"},
	    {Get(c_DemoFBX), "are new ('haunch', 'loin', 'ribs'", "0"}};
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pChange);
		TakeLog();
		// The first as programs do that write beside the file and rename, then in place.
		const bool bRenamed = &rRow == rows;
		Put(bRenamed ? m_Folder / "new.tmp" : file, rRow.m_Content);
		if (bRenamed)
			fs::rename(m_Folder / "new.tmp", file);
		std::string log;
		EXPECT_TRUE(WaitFor(
		    [&]
		    {
			    Run();
			    log += TakeLog();
			    return log.find("a.fbx' has changed on disk and was read again: ") != std::string::npos;
		    },
		    60000));
		EXPECT_NE(log.find(rRow.m_pChange), std::string::npos) << log;
		EXPECT_NE(log.find("The target subject stays as it was"), std::string::npos);
		Run();
		EXPECT_EQ(Parameter("TargetRoot").GetEnumeration().size(), m_pDocument->GetFBXSkeleton()->size());
		EXPECT_EQ(Text("TargetRoot"), rRow.m_pRoot);
		EXPECT_EQ(Target().m_Segments[0].m_Name, "loin");
		EXPECT_EQ(Type("TargetRoot", "2"), "");
	}

	// Chosen no more, as after the file was gone for a while.
	Parameter("TargetFBX").ClearValue();
	Run();
	TakeLog();
	bool bTold = false;
	RetargetSetup::VFollowedFile same([&bTold] { bTold = true; });
	same.Follow(QString::fromStdString(file.native()));
	Put(file, heaps);
	EXPECT_TRUE(WaitFor([&bTold] { return bTold; }, 60000));
	Run();
	EXPECT_EQ(TakeLog().find("has changed on disk"), std::string::npos);
}

TEST_F(Handlers, SourcesAreNeverLookedForWhereTheProcessRuns)
{
	OpenDemo();
	EXPECT_EQ(m_pDocument->GetShownSourceName(), "performer");
	m_pDocument->CreateTargetSubject();
	VSubjectParametrised subject;
	CoreOrlexTypes::VSubjectApplicationData data;
	ASSERT_TRUE(m_pDocument->GetTargetSubjectAndData(subject, data));
	const auto saveWithSource = [&](const char* i_pSource)
	{
		data.m_RetargetSourceTemplate = i_pSource;
		m_pDocument->SetTargetSubject(subject, data);
		EXPECT_EQ(m_pDocument->SaveTargetSubject(m_Folder / "a.qrr"), 0u);
		m_pDocument->SetTargetSubject(subject, data);
		Run();
		TakeLog();
		EXPECT_EQ(m_pDocument->LoadTargetSubject(m_Folder / "a.qrr"), 0u);
		Run();
	};
	saveWithSource("elsewhere");
	EXPECT_EQ(Text("SourceSkeleton"), "elsewhere");
	EXPECT_NE(
	    TakeLog().find("Source 'elsewhere' is in none of the folders, still showing 'performer'"), std::string::npos);
	EXPECT_EQ(m_pDocument->GetShownSourceName(), "performer");

	EXPECT_EQ(Type("SourceSkeleton", "performer"), "");
	EXPECT_EQ(m_pDocument->GetSourceName(), "performer") << "loaded again, since the document had been told another";
	saveWithSource("performer");
	EXPECT_EQ(fs::path(Text("SourceSkeleton")).filename(), "performer.qrs");
	saveWithSource("");
	EXPECT_EQ(Text("SourceSkeleton"), "") << "a subject without a source clears the choice";
}

TEST_F(Handlers, TheSourceThatIsThereIsNotReadAgain)
{
	OpenDemo();
	const auto pBefore = m_pDocument->SourceValues().m_pParametrised;
	m_pDocument->CreateTargetSubject();
	Run();
	Parameter("SourceSkeleton").SetValue(ToVariant(std::string("gone")));
	Run();
	EXPECT_EQ(Type("SourceSkeleton", "performer"), "");
	EXPECT_EQ(m_pDocument->SourceValues().m_pParametrised, pBefore);
	const fs::path skin = Copy(c_DemoFBX, "skins/OrlexA.fbx");
	Parameter("SourceSkin").SetValue(ToVariant(skin));
	Run();
	EXPECT_NE(m_pDocument->SourceValues().m_pParametrised, pBefore);
	EXPECT_EQ(m_pDocument->SourceValues().m_pApplicationData->m_Skin, "OrlexA");
	TakeLog();
	Parameter("SourceSkeleton").SetValue(ToVariant(Copy(c_DemoSource, "subjects/anna.qrs").string()));
	Run();
	EXPECT_NE(TakeLog().find("The skin 'OrlexA' was chosen for source 'performer', and 'anna' wears it now"),
	    std::string::npos);
	EXPECT_EQ(m_pDocument->SourceValues().m_pApplicationData->m_Skin, "OrlexA");
	EXPECT_EQ(m_pDocument->SaveTargetSubject(m_Folder / "a.qrr"), 0u);
	EXPECT_EQ(Type("SourceSkeleton", "performer"), "");
	EXPECT_EQ(m_pDocument->LoadTargetSubject(m_Folder / "a.qrr"), 0u);
	const fs::path other = Copy(c_DemoSource, "elsewhere/bea.qrs");
	Parameter("SourceSkeleton").SetValue(ToVariant(other.string()));
	Run();
	EXPECT_EQ(m_pDocument->GetShownSourceName(), "bea") << "chosen before the panel had heard of the subject";
}

TEST_F(Handlers, StoredValuesAreThereAgain)
{
	const fs::path source = Copy(c_DemoSource, "subjects/anna.qrs");
	OpenDemo();
	Parameter("SourceSkeleton").SetValue(ToVariant(source.string()));
	EXPECT_EQ(Type("TargetRoot", "3"), "");
	EXPECT_EQ(Type("TargetScale", "1.25"), "");
	m_pWidget.reset();
	Run();
	TakeLog();

	Open();
	EXPECT_EQ(m_pDocument->GetShownSourceName(), "anna") << "from outside the folders";
	ASSERT_TRUE(m_pDocument->GetFBXSkeleton());
	EXPECT_EQ(Text("TargetRoot"), "3");
	m_pDocument->CreateTargetSubject();
	Run();
	EXPECT_EQ(Target().m_Segments[0].m_Name, (*m_pDocument->GetFBXSkeleton())[3].m_Name);
	EXPECT_EQ(m_pDocument->GetTargetScale(), 1.25);
	EXPECT_EQ(TakeLog().find("none of the folders"), std::string::npos);
}

TEST_F(Handlers, SkinsAreLookedForInTheUsersFolder)
{
	Copy(c_DemoFBX, "skins/dragon.fbx");
	m_Context.Folders().SetFolder("FolderSkins", m_Folder / "skins");
	Open();
	std::shared_ptr<CoreGraphics::VSkin> pSkin;
	const auto status = [&](const char* i_pName) { return m_pGui->m_pSkinCache->GetSkin(pSkin, i_pName, "Subject"); };
	EXPECT_EQ(status("dragon"), OrlexGraphics::SkinStatus::c_Ready);
	m_Context.Folders().SetFolder("FolderSkins", m_Folder / "none");
	Run();
	EXPECT_EQ(status("dragon"), OrlexGraphics::SkinStatus::c_NotFound);
}

TEST_F(Handlers, ChoicesFollowTheDiskAndNothingElseMoves)
{
	const fs::path anna = Copy(c_DemoSource, "subjects/anna.qrs");
	Copy(c_DemoFBX, "skins/dragon.fbx");
	m_Context.Folders().SetFolder("FolderSubjects", m_Folder / "subjects");
	m_Context.Folders().SetFolder("FolderSkins", m_Folder / "skins");
	Open();
	EXPECT_EQ(Type("SourceSkeleton", "anna"), "");
	EXPECT_EQ(Type("TargetFBX", "dragon"), "");
	m_pDocument->CreateTargetSubject();
	Run();
	const auto names = [this](const char* i_pKey)
	{
		std::string text;
		for (const TesselPluginInterface::VEnumEntry& rEntry : Parameter(i_pKey).GetEnumeration())
			text += rEntry.m_Name + " ";
		return text;
	};
	const auto becomes = [&](const char* i_pKey, const std::string& i_rNames)
	{
		return QTest::qWaitFor(
		    [&]
		    {
			    Run();
			    return names(i_pKey) == i_rNames;
		    },
		    60000);
	};
	m_pDocument->GetChangedSignal().Connect([this] { ++m_Changes; });
	fs::copy_file(anna, m_Folder / "subjects/bea.qrs");
	EXPECT_TRUE(becomes("SourceSkeleton", "anna bea ")) << names("SourceSkeleton");
	fs::rename(m_Folder / "subjects/bea.qrs", m_Folder / "subjects/zoe.qrs");
	EXPECT_TRUE(becomes("SourceSkeleton", "anna zoe ")) << names("SourceSkeleton");
	EXPECT_EQ(Text("SourceSkeleton"), anna.string());
	fs::remove(m_Folder / "skins/dragon.fbx");
	EXPECT_TRUE(becomes("TargetFBX", "(None) ")) << names("TargetFBX");
	EXPECT_EQ(Text("TargetFBX"), "");
	EXPECT_TRUE(m_pDocument->GetFBXSkeleton()) << "what was read of it stays";
	EXPECT_EQ(Text("SourceSkeleton"), anna.string());
	EXPECT_EQ(m_Changes, 0);
}

TEST_F(Handlers, EndWithThePanel)
{
	OpenDemo();
	Parameter("TargetScale").SetValue(ToVariant(4.0));
	m_pDocument->CreateTargetSubject();
	m_pWidget.reset();
	Run();
	EXPECT_EQ(m_pDocument->GetTargetScale(), 1.0) << "what was posted finds nobody";
	m_pDocument->CreateTargetSubject();
	m_Context.Folders().SetFolder("FolderSubjects", "/");
	Run();
}

} // namespace
