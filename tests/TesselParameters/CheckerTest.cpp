#include "TesselParameters/Attributes.h"
#include "TesselParameters/ParameterGroup.h"

#include "TesselDataStore/DataStore.h"
#include "TesselDataStore/DataWriter.h"

#include <gtest/gtest.h>

#include <cmath>

namespace
{

using namespace TesselParameters;
using TesselDataStore::ToVariant;
using TesselPluginInterface::EValueKind;

TEST(Checker, TextOfEachType)
{
	const VParameterCheckerTyped<bool> flag;
	const VParameterCheckerTyped<std::int32_t> number;
	const VParameterCheckerTyped<std::uint32_t> count;
	const VParameterCheckerTyped<double> real;
	const VParameterCheckerTyped<std::string> text;
	const VParameterCheckerTyped<boost::filesystem::path> path;
	EXPECT_EQ(flag.GetValueKind(), EValueKind::EBool);
	EXPECT_EQ(number.GetValueKind(), EValueKind::EInteger);
	EXPECT_EQ(count.GetValueKind(), EValueKind::EInteger);
	EXPECT_EQ(real.GetValueKind(), EValueKind::EReal);
	EXPECT_EQ(text.GetValueKind(), EValueKind::EText);
	EXPECT_EQ(path.GetValueKind(), EValueKind::EPath);

	const struct
	{
		const VParameterChecker& m_rChecker;
		const char* m_pText;
		/// How it is shown again; null if it is refused.
		const char* m_pShown;
	} rows[] = {
	    {flag, "true", "true"},
	    {flag, "0", "false"},
	    {flag, "1", "true"},
	    {flag, "yes", nullptr},
	    {flag, "", nullptr},
	    {number, "-2147483648", "-2147483648"},
	    {number, "2147483648", nullptr},
	    {number, "1.5", nullptr},
	    {number, " 1", nullptr},
	    {count, "4294967295", "4294967295"},
	    {count, "4294967296", nullptr},
	    {count, "-1", nullptr},
	    {count, "", nullptr},
	    {real, "0.1", "0.1"},
	    {real, "1e3", "1000"},
	    {real, "0.30000000000000004", "0.30000000000000004"},
	    {real, "1.5x", nullptr},
	    {real, "1,5", nullptr},
	    {real, "", nullptr},
	    {real, "nan", nullptr},
	    {real, "inf", nullptr},
	    {real, "1e999", nullptr},
	    {text, "", ""},
	    {text, "a b", "a b"},
	    {path, "/a/b.fbx", "/a/b.fbx"},
	};
	for (const auto& rRow : rows)
	{
		NVX::IO::VVariant value;
		EXPECT_EQ(rRow.m_rChecker.FromText(rRow.m_pText, value), rRow.m_pShown != nullptr) << rRow.m_pText;
		EXPECT_EQ(rRow.m_rChecker.ToText(value), rRow.m_pShown ? rRow.m_pShown : "") << rRow.m_pText;
	}
	EXPECT_EQ(real.ToText(ToVariant("text")), "");
}

TEST(Checker, LimitsAndPermittedValues)
{
	const auto limits = [](double i_Minimum, double i_Maximum)
	{ return [=](VParameter& io_rParameter) { io_rParameter.SetLimits(i_Minimum, i_Maximum); }; };
	const auto nothing = [](VParameter&) {};
	const auto list = [](VParameter& io_rParameter) {
		io_rParameter.SetEnumeration({{"low", ToVariant(1.0)}, {"high", ToVariant(2.0)}});
	};
	const auto emptyList = [](VParameter& io_rParameter) { io_rParameter.SetEnumeration({}); };
	const auto expression = [](const char* i_pText)
	{ return [=](VParameter& io_rParameter) { io_rParameter.SetValidatorRegEx(i_pText); }; };
	const char* const pLess = "Value is less than permitted minimum";
	const char* const pGreater = "Value is greater than permitted maximum";
	const char* const pOther = "Value is not one of the permitted values";
	const struct
	{
		const char* m_pName;
		std::function<void(VParameter&)> m_Set;
		const char* m_pText;
		const char* m_pMessage;
	} rows[] = {
	    {"no rule", nothing, "-1e300", ""},
	    {"at the minimum", limits(1.0, 100.0), "1", ""},
	    {"below", limits(1.0, 100.0), "0.99", pLess},
	    {"at the maximum", limits(1.0, 100.0), "100", ""},
	    {"above", limits(1.0, 100.0), "100.5", pGreater},
	    {"above a maximum that is no number", limits(1.0, std::nan("")), "2", pGreater},
	    {"listed", list, "2", ""},
	    {"listed by name", list, "high", ""},
	    {"not listed", list, "3", pOther},
	    {"no list at all", emptyList, "3", ""},
	    {"no number", nothing, "abc", "Value is not a number"},
	    {"matches", expression("[0-9]+"), "12", ""},
	    {"matches in part", expression("[0-9]+"), "12.5", "Value does not match the form \"[0-9]+\""},
	    {"no expression", expression("["), "1", "Value does not match the form \"[\""},
	    {"calls itself", expression("[0-9](?R)?"), "12", "Value does not match the form \"[0-9](?R)?\""},
	    {"calls its group", expression("([0-9])(?-1)"), "12", "Value does not match the form \"([0-9])(?-1)\""},
	    {"a bracket that may be missing", expression("\\(?1?2"), "12", ""},
	    {"letters of a set", expression("[(?1]+2"), "12", ""},
	    {"a group that is not counted", expression("(?:1)(?i)2"), "12", ""},
	};
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		VParameterGroup group(nullptr, "Path", "Group");
		const auto pParameter = group.Add<double>("Name");
		pParameter->Set(55.0);
		rRow.m_Set(*pParameter);
		EXPECT_EQ(pParameter->SetValueText(rRow.m_pText), rRow.m_pMessage);
		double value = 0.0;
		EXPECT_TRUE(pParameter->Get(value));
		EXPECT_EQ(value == 55.0, *rRow.m_pMessage != '\0');
		// A program is not bound.
		EXPECT_TRUE(pParameter->Set(0.5));
	}
}

TEST(Checker, ALimitOfAnotherTypeIsNone)
{
	const auto pStore = std::make_shared<TesselDataStore::VDataStore>();
	const VParameterCheckerTyped<double> checker;
	const NVX::IO::VVariant bound = ToVariant(10.0);
	const struct
	{
		const char* m_pName;
		NVX::IO::VVariant m_Minimum;
		bool m_bPermitted;
	} rows[] = {{"whole", bound, false}, {"too short", {bound.m_pSchema, bound.m_Bytes.substr(0, 7)}, true},
	    {"32-bit float", ToVariant(10.0f), true}, {"integer of 64 bits", ToVariant<std::int64_t>(10), true},
	    {"text", ToVariant("10"), true}, {"empty", {}, true}};
	for (const auto& rRow : rows)
	{
		TesselDataStore::VDataWriter attributes(pStore);
		attributes.Set(AttributeKeys::c_Min, rRow.m_Minimum);
		std::string message;
		EXPECT_EQ(checker.IsPermitted(ToVariant(1.0), attributes, message), rRow.m_bPermitted) << rRow.m_pName;
		EXPECT_EQ(message.empty(), rRow.m_bPermitted);
	}
	std::string message;
	EXPECT_FALSE(checker.IsPermitted(ToVariant(1.0f), TesselDataStore::VDataReader(pStore), message));
}

} // namespace
