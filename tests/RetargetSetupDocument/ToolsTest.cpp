// What the document hands out for a host's tools, as texts: pairs of presets, comparisons, advice, another performer or
// file.

#include "../WaitFor.h"
#include "TestDocument.h"

#include <boost/filesystem/operations.hpp>

#include <functional>

namespace
{

using CoreOrlexTypes::VSubjectParametrised;

class Tools : public VDocumentTest
{
protected:
	void Make()
	{
		ASSERT_TRUE(m_Document.LoadTargetFBX(RETARGET_SOURCE "/demo/character.fbx"));
		ASSERT_TRUE(m_Document.LoadSourceSubject(RETARGET_SOURCE "/demo/performer.qrs", ""));
		m_Document.CreateTargetSubject();
	}

	void Edit(const std::function<void(VSubjectParametrised&)>& i_rEdit)
	{
		VSubjectParametrised subject = Target();
		i_rEdit(subject);
		m_Document.SetTargetSubjectParametrised(subject);
	}

	void Rename(bool i_bSource, std::size_t i_Segment, const char* i_pName)
	{
		const auto values = i_bSource ? m_Document.SourceValues() : m_Document.TargetValues();
		VSubjectParametrised subject = *values.m_pParametrised;
		subject.m_Segments[i_Segment].m_Name = i_pName;
		i_bSource ? m_Document.SetSourceSubject(subject, *values.m_pApplicationData)
		          : void(m_Document.SetTargetSubject(subject, *values.m_pApplicationData));
	}
};

TEST_F(Tools, FitPresetsByNamesAndByWhatIsProposed)
{
	Make();
	Put(m_Folder / "a.json", R"({"pairs": [{"source": "Pelvis", "target": "haunch"},
{"source": "Cervical", "target": "neck"}, {"source": "head", "target": "skull"},
{"source": "root", "target": "haunch"}, {"source": "wing", "target": "cape1"}]})");
	const QVariantMap fit = m_Document.FitPreset(Url("a.json"), 0.5);
	std::string pairs;
	for (const QVariant& rPair : fit["pairs"].toList())
	{
		const QVariantMap pair = rPair.toMap();
		pairs += std::to_string(pair["source"].toInt()) + ">" + std::to_string(pair["target"].toInt()) + ": "
		    + pair["reasons"].toString().toStdString() + "\n";
	}
	EXPECT_EQ(pairs,
	    "0>0: by names in the preset\n"
	    "4>4: in the preset \"Cervical\" and \"neck\", here what is proposed for them\n"
	    "5>5: in the preset \"head\" and \"skull\", here what is proposed for them\n");
	EXPECT_EQ(fit["misfits"].toStringList().join('\n').toStdString(),
	    "\"root\" and \"haunch\": the source has no segment \"root\", and what is proposed in its place stands in "
	    "another pair\n"
	    "\"wing\" and \"cape1\": the source has no segment \"wing\", and nothing is proposed in its place");
	Put(m_Folder / "a.json", R"({"fbx": "a.fbx"})");
	EXPECT_TRUE(m_Document.FitPreset(Url("a.json"), 0.5).isEmpty());
	EXPECT_EQ(TakeTold(), "FitPreset: '" + File("a.json") + "', line 1: \"fbx\" does not belong into a preset");
}

TEST_F(Tools, SaveWhatAPresetCanHold)
{
	Make();
	m_Document.AddTarget(0, 0, true, false);
	m_Document.AddTarget(0, 0, false, false);
	Edit(
	    [](VSubjectParametrised& io_rSubject)
	    {
		    auto& rTargets = io_rSubject.m_Targets;
		    rTargets.insert(rTargets.end(), {rTargets[0], {}, rTargets[1]});
		    rTargets.back().m_SegmentIndices.clear();
	    });
	m_Quiet.Take();
	EXPECT_TRUE(m_Document.SavePresetURL(Url("a.json"))) << TakeTold();
	EXPECT_EQ(m_Quiet.Take(),
	    "3 RetargetSetup: Target #2 is left out: there is one of its kind for the pair \"Pelvis\" and \"haunch\" "
	    "already\n"
	    "3 RetargetSetup: Target #3 is left out: a pair holds positions and rotations only\n"
	    "3 RetargetSetup: Target #4 is left out: one of its segments has no name");
	EXPECT_EQ(Get(m_Folder / "a.json"),
	    "{\n\t\"comment\": \"Pairs of performer and character\",\n\t\"pairs\": [\n"
	    "\t\t{\"source\": \"Pelvis\", \"target\": \"haunch\", \"position\": 1.0, \"rotation\": 1.0}\n\t]\n}\n");
}

TEST_F(Tools, CompareWithAFileAndCheckThePose)
{
	Make();
	m_Document.AddTarget(0, 0, true, false);
	m_Document.SaveTargetSubject(m_Folder / "a.qrr");
	EXPECT_EQ(m_Document.CompareWith(Url("a.qrr"))["summary"], "Nothing differs.");
	m_Document.AddTarget(1, 1, false, false);
	const QVariantMap changes = m_Document.CompareWith(Url("a.qrr"));
	EXPECT_EQ(changes["summary"], "Differences, from the file to what is here now: 2");
	EXPECT_EQ(changes["rows"].toList()[1].toMap()["about"], "target \"Rotation Lumbar > loin\": added");

	const QVariantMap demo = m_Document.CheckPose();
	EXPECT_EQ(demo["summary"], "To be looked at: 2 of 7.");
	EXPECT_EQ(demo["rows"].toList()[4].toMap()["cells"].toStringList().back(),
	    "\"Align to Source...\", or retarget edit with --root-height scale --scale 1.264 --update-targets");
	SetSmallSubjects();
	EXPECT_EQ(m_Document.CheckPose()["summary"], "Both stand alike.");
}

TEST_F(Tools, AdviseAlsoWithoutASource)
{
	int count = 0;
	const QCoreApplication application(count, nullptr);
	QVariantMap advice;
	QObject::connect(&m_Document, &VRetargetSetup::advised, [&](const QVariantMap& i_rAdvice) { advice = i_rAdvice; });
	const auto advised = [&]
	{
		advice.clear();
		EXPECT_TRUE(m_Document.Advise());
		EXPECT_TRUE(m_Document.Advise()) << "once more";
		EXPECT_TRUE(WaitFor([&] { return !advice.isEmpty(); }, 60'000));
		return advice["summary"].toString().toStdString();
	};
	boost::filesystem::copy_file(RETARGET_SOURCE "/demo/character.fbx", m_Folder / "a.fbx");
	ASSERT_TRUE(m_Document.LoadTargetFBX(m_Folder / "a.fbx"));
	m_Document.CreateTargetSubject();
	const std::string c_Joints = "Joints without a target of their own: 38.";
	const std::string c_NoSource = " Without a source skeleton there is no range of motion.";
	EXPECT_EQ(advised(), c_Joints + c_NoSource);
	boost::filesystem::remove(m_Folder / "a.fbx");
	EXPECT_EQ(advised(),
	    c_Joints + " Which must stay for the skin is not known: the character's FBX file is not open." + c_NoSource);
	// A character of half the size, which is asked to be where the performer is.
	SetSmallSubjects();
	for (int i = 0; i < 5; ++i)
		m_Document.AddTarget(i, i, true, false);
	const std::string c_Range = "Every joint carries a target. Range of motion: 96 poses, ";
	EXPECT_EQ(advised().substr(0, c_Range.size()), c_Range);
	const QVariantList rows = advice["rows"].toList();
	ASSERT_FALSE(rows.isEmpty());
	const QStringList cells = rows[0].toMap()["cells"].toStringList();
	EXPECT_EQ(cells[1], "is pulled");
	EXPECT_TRUE(cells[3].contains(" pulls against it: it is missed by ")) << cells[3].toStdString();
}

TEST_F(Tools, LookAtAnotherPerformerOrFile)
{
	Make();
	m_Document.AddTarget(0, 0, true, false);
	m_Document.AddTarget(1, 1, false, false);
	const auto texts = [this](bool i_bPerformer)
	{
		const QVariantMap rebound = m_Document.LookAtRebind(i_bPerformer);
		if (rebound.isEmpty())
			return std::string("as it is");
		QString text = rebound["refusal"].toString();
		for (const char* const pList : {"renamed", "lost", "changed", "added"})
			text += rebound[pList].toStringList().join("; ") + "|";
		return (text + rebound["kept"].toString()).toStdString();
	};
	EXPECT_EQ(texts(false), "as it is");
	EXPECT_EQ(texts(true), "as it is");
	Rename(false, 1, "other");
	EXPECT_EQ(texts(false), "other is loin, by its place||||38");
	Rename(true, 1, "Spine");
	EXPECT_EQ(texts(true), "Lumbar is Spine, as the same part of a body, score 0.85||||1");
	m_Document.Rebind(false, true);
	EXPECT_EQ(texts(false) + TakeTold(), "as it is");
	Edit([](VSubjectParametrised& io_rSubject)
	    { io_rSubject.m_Segments[2].m_Joint.m_JointType = VSubjectParametrised::VJoint::EHinge; });
	EXPECT_EQ(
	    texts(false), "The subject has joints, post poses or parameters that no FBX file gives: make it anew||||");
	m_Document.Rebind(false, false);
	EXPECT_EQ(
	    TakeTold(), "Rebind: The subject has joints, post poses or parameters that no FBX file gives: make it anew");
	SetSmallSubjects();
	m_Document.AddTarget(1, 1, false, false);
	const QVariantMap bones = m_Document.LookAtRebind(false);
	EXPECT_EQ(bones["renamed"].toStringList(), QStringList{"pelvis is haunch, by its place"});
	EXPECT_EQ(bones["lost"].toStringList(),
	    QStringList{"Target 0 \"LeftArm}arm_l\" of weight 1: the new character has no \"arm_l\""});
	EXPECT_TRUE(bones["changed"].toStringList().contains("segment \"hand_r\": removed"));
	EXPECT_EQ(bones["added"].toStringList().size(), 38);
	Rename(true, 1, "Stick");
	EXPECT_EQ(texts(true),
	    "|The new performer has no segment \"LeftArm\", and none was found in its place: the targets that follow it "
	    "keep its name, and follow nothing|||0");

	VRetargetSetup other(m_Host.GetDispatcher(), m_Host.GetFrameFactory(), m_Host.GetItemFactory());
	std::string told;
	QObject::connect(&other, &VRetargetSetup::commandIgnored,
	    [&](const QString&, const QString& i_rReason) { told += i_rReason.toStdString() + "|"; });
	const auto target = m_Document.TargetValues();
	other.SetTargetSubject(*target.m_pParametrised, *target.m_pApplicationData);
	EXPECT_TRUE(other.LookAtRebind(true).isEmpty());
	other.Rebind(true, false);
	other.Rebind(false, false);
	EXPECT_EQ(told,
	    "There is no source subject. Choose a source skeleton first.|No skeleton has been read from an FBX file. "
	    "Choose a target FBX first.|");
}

TEST_F(Tools, AlignWhatTargetsTie)
{
	Make();
	const QVariantList all{true, true, true, true};
	EXPECT_TRUE(m_Document.AlignToSource(all, {}, false, false).isEmpty());
	EXPECT_EQ(TakeTold(),
	    "AlignToSource: No target ties a segment of the target subject to one of the source. Add targets first.");
	for (const int segment : {13, 14, 15})
		m_Document.AddTarget(segment, segment + 9, true, false);
	const auto aligned = [&](bool i_bFitScale)
	{
		std::string text;
		for (const QVariant& rJoint :
		    m_Document.AlignToSource(all, {-1, 22, 1000}, i_bFitScale, true)["joints"].toList())
			text += rJoint.toMap()["target"].toString().toStdString() + " "
			    + rJoint.toMap()["note"].toString().toStdString() + "|";
		return text;
	};
	EXPECT_EQ(aligned(true), "22 stays: it is locked|23 |");
	EXPECT_NEAR(m_Document.GetTargetScale(), 1.278, 1e-9);
	EXPECT_TRUE(m_Document.IsAligning());
	m_Document.EndAlignment(false);
	EXPECT_EQ(m_Document.GetTargetScale(), 1.0);
	// The performer's elbow.
	Edit([&](VSubjectParametrised& io_rSubject)
	    { io_rSubject.m_Segments[23].m_Joint = m_Document.SourceValues().m_pParametrised->m_Segments[9].m_Joint; });
	EXPECT_EQ(aligned(false), "22 stays: it is locked|23 stays: it has no joint that turns every way|") << TakeTold();
	m_Document.EndAlignment(true);
	SetSmallSubjects();
	for (int i = 0; i < 5; ++i)
		m_Document.AddTarget(i, i, true, false);
	const QVariantMap small = m_Document.AlignToSource(all, {}, true, false);
	EXPECT_EQ(small["scale"], 1.0) << "without feet there is nothing to scale it by";
	EXPECT_EQ(small["heights"], "");
}

} // namespace
