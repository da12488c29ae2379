#include "Flow2TypesUtils/ParameterSet.h"
#include "Flow2TypesUtils/FlowParametersItem.h"

#include <gtest/gtest.h>

namespace
{

using namespace Flow2Utils;
using Flow2TypesUtils::FlowParametersItem;

/// A set with a pose index of 0 by default, a scale between 0 and 10 and an optional name.
class ParameterSet : public testing::Test
{
protected:
	ParameterSet() : m_pCookie(m_Set.Watch([this](const std::string& i_rName) { m_Told += i_rName + ";"; }))
	{
		Fill(m_Set);
	}

	static void Fill(VParameterSet& o_rSet)
	{
		auto pPose = std::make_unique<VParameterTyped<std::uint32_t>>("PoseIndex");
		pPose->SetDefault(0);
		o_rSet.Add(std::move(pPose));
		auto pScale = std::make_unique<VParameterTyped<double>>("Scale");
		pScale->SetMinimum(0.0);
		pScale->SetMaximum(10.0);
		o_rSet.Add(std::move(pScale));
		auto pName = std::make_unique<VParameterTyped<std::string>>("Name");
		pName->m_bOptional = true;
		o_rSet.Add(std::move(pName));
	}

	/// An item that sets the scale, and the pose index by its default.
	static std::shared_ptr<FlowParametersItem> Item(double i_Scale)
	{
		VParameterSet set;
		Fill(set);
		set.SetValue("Scale", i_Scale);
		auto pItem = std::make_shared<FlowParametersItem>();
		pItem->m_pParameters = set.Clone();
		return pItem;
	}

	std::string Take() { return std::exchange(m_Told, {}); }

	VParameterSet m_Set;
	std::string m_Told;
	std::shared_ptr<VParameterSetCookie> m_pCookie;
};

TEST_F(ParameterSet, SetParameterRows)
{
	const struct
	{
		const char* m_pName;
		const char* m_pText;
		std::uint32_t m_Status;
		const char* m_pMessage;
		const char* m_pTold;
	} rows[] = {
	    {"Scale", "2.5", 0, "", "Scale;"},
	    {"Scale", "2.5", 0, "", ""},
	    {"Scale", "2.5mm", 0x80000016u, "Could not parse parameter Scale\n", ""},
	    {"scale", "2", 0x80000011u, "Unknown parameter scale\n", ""},
	    {"%1%", "2", 0x80000011u, "Unknown parameter %1%\n", ""},
	    {"PoseIndex", "-1", 0x80000016u, "Could not parse parameter PoseIndex\n", ""},
	    {"Scale", "99", 0, "", "Scale;"},
	    {"Name", "", 0, "", "Name;"},
	};
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(std::string(rRow.m_pName) + " " + rRow.m_pText);
		std::string message = "Before\n";
		EXPECT_EQ(m_Set.SetParameter(rRow.m_pName, rRow.m_pText, VParameterSet::EReport, &message), rRow.m_Status);
		EXPECT_EQ(message, std::string("Before\n") + rRow.m_pMessage) << "appended";
		EXPECT_EQ(Take(), rRow.m_pTold);
	}
	std::string message;
	EXPECT_EQ(m_Set.SetParameter("none", "2", 0, &message), 0x80000011u);
	EXPECT_EQ(message, "") << "not asked for";
	EXPECT_EQ(m_Set.SetParameter("none", "2", VParameterSet::EReport), 0x80000011u) << "nowhere to tell it";
}

TEST_F(ParameterSet, TypedValues)
{
	EXPECT_EQ(m_Set.Value<std::uint32_t>("PoseIndex", 8), 0u) << "the default";
	EXPECT_EQ(m_Set.Value<double>("Scale", 8.0), 8.0) << "neither value nor default";
	EXPECT_EQ(m_Set.Value<float>("PoseIndex", 8.0f), 8.0f) << "another type";
	EXPECT_EQ(m_Set.Value<double>("none", 8.0), 8.0);
	EXPECT_EQ(m_Set.SetValue("Scale", 3.0), 0u);
	EXPECT_EQ(m_Set.Value<double>("Scale", 8.0), 3.0);
	EXPECT_EQ(m_Set.SetValue("Scale", 3.0f), 0x80000000u) << "another type";
	EXPECT_EQ(m_Set.SetValue("none", 3.0), 0x80000011u);
	EXPECT_EQ(Take(), "Scale;");
	EXPECT_FALSE(m_Set.Add(nullptr));
	EXPECT_FALSE(m_Set.Add(std::make_unique<VParameterTyped<bool>>("Scale"))) << "the name is taken";
	EXPECT_EQ(m_Set.Value<double>("Scale", 8.0), 3.0);
	m_Set.Reset();
	EXPECT_EQ(Take(), "Scale;") << "only what was set is reset";
	EXPECT_EQ(m_Set.Value<double>("Scale", 8.0), 8.0);
}

TEST_F(ParameterSet, ValidityNamesEachParameter)
{
	std::string message = "from before";
	EXPECT_FALSE(m_Set.IsValid(message));
	EXPECT_EQ(message, "Parameter Scale: Value is not set\n");
	auto pLimited = std::make_unique<VParameterTyped<float>>("Again");
	pLimited->SetDefault(5.0f);
	pLimited->AddPermitted("One", 1.0f);
	m_Set.Add(std::move(pLimited));
	m_Set.SetValue("Scale", -1.0);
	EXPECT_FALSE(m_Set.IsValid(message));
	EXPECT_EQ(message,
	    "Parameter Again: Value is not one of the permitted values\n"
	    "Parameter Scale: Value is less than permitted minimum\n");
	m_Set.SetParameter("Again", "One");
	m_Set.SetValue("Scale", 10.0);
	EXPECT_TRUE(m_Set.IsValid(message));
	EXPECT_EQ(message, "");
}

TEST_F(ParameterSet, TheCookieKeepsTheNotificationAlive)
{
	m_Set.SetValue("Scale", 1.0);
	EXPECT_EQ(Take(), "Scale;");
	m_pCookie.reset();
	m_Set.SetValue("Scale", 2.0);
	EXPECT_EQ(Take(), "");
	std::shared_ptr<VParameterSetCookie> pOutliving;
	{
		VParameterSet set;
		pOutliving = set.Watch([](const std::string&) {});
	}
	// A callback may end its own notification.
	m_pCookie = m_Set.Watch(
	    [this](const std::string&)
	    {
		    m_Told += "once;";
		    m_pCookie.reset();
	    });
	m_Set.SetValue("Scale", 3.0);
	m_Set.SetValue("Scale", 4.0);
	EXPECT_EQ(Take(), "once;");
}

TEST_F(ParameterSet, AnItemIsAppliedOnce)
{
	const auto pItem = Item(2.0);
	EXPECT_EQ(m_Set.Apply(pItem), 0u);
	EXPECT_EQ(Take(), "PoseIndex;Scale;");
	const std::uint64_t counter = m_Set.ChangeCounter();
	EXPECT_EQ(m_Set.Apply(pItem), 0u);
	EXPECT_EQ(m_Set.ChangeCounter(), counter);
	EXPECT_EQ(Take(), "");
	EXPECT_EQ(m_Set.Apply(nullptr), 0u);
	EXPECT_EQ(m_Set.Apply(std::make_shared<FlowParametersItem>()), 0u) << "an item without parameters";
}

TEST_F(ParameterSet, WhenAnItemIsAppliedAgainRows)
{
	const auto pFirst = Item(2.0);
	/// Its parameters differ, so that an application shows.
	const auto other = [](std::uint64_t i_Identity, std::uint64_t i_Revision)
	{
		const auto pItem = Item(5.0);
		pItem->m_Identity = i_Identity;
		pItem->m_Revision = i_Revision;
		return pItem;
	};
	const struct
	{
		const char* m_pName;
		std::function<void()> m_Between;
		std::shared_ptr<const FlowParametersItem> m_pItem;
		std::uint32_t m_Flags;
		double m_Scale;
	} rows[] = {
	    {"same identity and revision", [] {}, other(pFirst->m_Identity, 0), 0, 2.0},
	    {"a later revision", [] {}, other(pFirst->m_Identity, 1), 0, 5.0},
	    {"another identity", [] {}, other(FlowParametersItem::NewIdentity(), 0), 0, 5.0},
	    {"other flags", [] {}, other(pFirst->m_Identity, 0), VParameterSet::EReport, 5.0},
	    {"the set was changed", [this] { m_Set.SetValue("Scale", 7.0); }, pFirst, 0, 2.0},
	    {"another parameter was changed", [this] { m_Set.SetValue("PoseIndex", 9u); }, other(pFirst->m_Identity, 0), 0,
	        5.0},
	    {"the set was reset", [this] { m_Set.Reset(); }, pFirst, 0, 2.0},
	};
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		m_Set.Reset();
		EXPECT_EQ(m_Set.Apply(pFirst), 0u);
		rRow.m_Between();
		EXPECT_EQ(m_Set.Apply(rRow.m_pItem, rRow.m_Flags), 0u);
		EXPECT_EQ(m_Set.Value<double>("Scale", 0.0), rRow.m_Scale);
	}
}

TEST_F(ParameterSet, WhatCannotBeAppliedDoesNotStopTheRest)
{
	VParameterSet set;
	Fill(set);
	auto pUnknown = std::make_unique<VParameterTyped<bool>>("Extra");
	pUnknown->Set(true);
	set.Add(std::move(pUnknown));
	set.SetValue("Scale", 4.0);
	auto pItem = std::make_shared<FlowParametersItem>();
	pItem->m_pParameters = set.Clone();
	for (int time = 0; time < 2; ++time)
	{
		std::string message;
		EXPECT_EQ(m_Set.Apply(pItem, VParameterSet::EReport, &message), 0x80000011u) << "told each time";
		EXPECT_EQ(message, "Unknown parameter Extra\n");
		EXPECT_EQ(m_Set.Value<double>("Scale", 0.0), 4.0);
	}
}

TEST_F(ParameterSet, ACloneIsOnItsOwn)
{
	m_Set.SetValue("Scale", 4.0);
	const auto pClone = m_Set.Clone();
	Take();
	pClone->SetValue("Scale", 5.0);
	EXPECT_EQ(Take(), "");
	EXPECT_EQ(m_Set.Value<double>("Scale", 0.0), 4.0);
	EXPECT_EQ(pClone->Parameters().size(), 3u);
	EXPECT_EQ(pClone->Value<double>("Scale", 0.0), 5.0);
}

} // namespace
