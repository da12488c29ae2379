#include "TestDocument.h"

namespace
{

using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;
using NVX::CountedPointer;

/// Counts what it is asked for and refuses one flow type.
class VRefusingItemFactory : public NVX::VCounted<TesselPluginInterface::IItemFactory>
{
public:
	CountedPointer<TesselPluginInterface::IFlowItem> CreateItem(const std::string& i_rFlowType) override
	{
		m_Asked += i_rFlowType + " ";
		return i_rFlowType == m_Refused ? nullptr : m_Factory.CreateItem(i_rFlowType);
	}

	std::string m_Asked;
	std::string m_Refused;

private:
	// Lives inside this object, so that it is never counted.
	class : public InMemoryHost::VItemFactory
	{
	} m_Factory;
};

class VRefusingFrameFactory : public NVX::VCounted<TesselPluginInterface::IFrameFactory>
{
public:
	CountedPointer<TesselPluginInterface::IFlowFrame> CreateFrame() override
	{
		++m_Asked;
		return m_bRefuse ? nullptr : CountedPointer<TesselPluginInterface::IFlowFrame>(new InMemoryHost::VFlowFrame);
	}

	int m_Asked = 0;
	bool m_bRefuse = false;
};

class RefusingHost : public testing::Test
{
protected:
	const CountedPointer<VRefusingItemFactory> m_pItems{new VRefusingItemFactory};
	const CountedPointer<VRefusingFrameFactory> m_pFrames{new VRefusingFrameFactory};
	VRetargetSetup m_Document{std::make_shared<InMemoryHost::VDispatcher>(), m_pFrames, m_pItems};
};

TEST_F(RefusingHost, AChangeAsksForEachItemAndOneFrame)
{
	const VSubjectParametrised subject = MakeSubject({{"a", -1}});
	m_Document.SetSourceSubject(subject, {});
	EXPECT_EQ(m_pItems->m_Asked, "FlowSubject FlowSubjectParametrised FlowSubjectApplicationData ");
	m_Document.SetTargetSubject(subject, {});
	m_pItems->m_Asked.clear();
	m_Document.SetTargetSubjectParametrised(subject);
	EXPECT_EQ(m_pItems->m_Asked, "FlowSubjectForSolving FlowSubjectParametrisedForSolving ")
	    << "the application data stays";
	EXPECT_EQ(m_pFrames->m_Asked, 3);
}

TEST_F(RefusingHost, WithoutAnItemEverythingStaysAsItWas)
{
	m_Document.SetTargetSubject(MakeSubject({{"a", -1}}), {});
	const auto before = m_Document.TargetValues();
	const auto pFrame = m_Document.GetCurrentFrame();
	int changes = 0;
	m_Document.GetChangedSignal().Connect([&changes] { ++changes; });
	for (const std::string refused :
	    {"FlowSubjectForSolving", "FlowSubjectParametrisedForSolving", "FlowSubjectApplicationDataForSolving"})
	{
		m_pItems->m_Refused = refused;
		VLogRecorder log;
		m_Document.SetTargetSubject(MakeSubject({{"b", -1}}), {});
		EXPECT_EQ(
		    log.Take(), "2 RetargetSetup: The host makes no item of type '" + refused + "': the change is dropped");
		EXPECT_EQ(m_Document.TargetValues().m_pParametrised, before.m_pParametrised);
		EXPECT_EQ(m_Document.TargetValues().m_pSubject, before.m_pSubject);
		EXPECT_EQ(m_Document.GetCurrentFrame(), pFrame);
	}
	EXPECT_EQ(changes, 0);
}

TEST_F(RefusingHost, ACommandWithoutAnItemIsToldAsIgnored)
{
	VSubjectApplicationData data;
	data.m_Segments.resize(1);
	m_Document.SetSourceSubject(MakeSubject({{"a", -1}}), data);
	m_Document.SetTargetSubject(MakeSubject({{"b", -1}}), data);
	m_Document.AddTarget(0, 0, true, false);
	ASSERT_TRUE(m_Document.LoadTargetFBX(RETARGET_SOURCE "/demo/character.fbx"));

	m_pItems->m_Refused = "FlowSubjectForSolving";
	std::string commands;
	QObject::connect(&m_Document, &VRetargetSetup::commandIgnored,
	    [&commands](const QString& i_rCommand, const QString& i_rReason)
	    {
		    commands += i_rCommand.toStdString() + " ";
		    EXPECT_EQ(i_rReason, "The host took no item for the change, so everything stays as it was.");
	    });
	VLogRecorder quiet;
	m_Document.AddTarget(0, 0, true, false);
	m_Document.RemoveTarget(0);
	m_Document.UpdateTargets();
	m_Document.CreateAllJoints();
	m_Document.RemoveUnnecessaryJoints();
	m_Document.CreateTargetSubject();
	EXPECT_EQ(
	    commands, "AddTarget RemoveTarget UpdateTargets CreateAllJoints RemoveUnnecessaryJoints CreateTargetSubject ");
	EXPECT_EQ(m_Document.TargetValues().m_pParametrised->m_Targets.size(), 1u);
}

TEST_F(RefusingHost, WithoutAFrameTheEditStands)
{
	m_pFrames->m_bRefuse = true;
	VLogRecorder log;
	m_Document.SetTargetSubject(MakeSubject({{"b", -1}}), {});
	EXPECT_EQ(log.Take(), "2 RetargetSetup: The host makes no frame: the preview cannot follow");
	EXPECT_FALSE(m_Document.GetCurrentFrame());
	EXPECT_EQ(m_Document.TargetValues().m_pParametrised->m_Segments.at(0).m_Name, "b");
	EXPECT_EQ(m_Document.GetTargetSegmentModel()->rowCount(), 1);
}

} // namespace
