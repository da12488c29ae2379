#include "Flow2TypesUtils/ParameterText.h"
#include "Flow2TypesUtils/ParameterTyped.h"
#include "TesselPluginInterface/IParameter.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

namespace
{

using namespace Flow2Utils;
using VAttributes = std::map<std::string, std::string>;

TEST(ParameterText, RealsRows)
{
	const struct
	{
		std::string m_Text;
		bool m_bReads;
		double m_Value = 0.0;
	} rows[] = {
	    {"1.5", true, 1.5},
	    {"  .5", true, 0.5},
	    {"+3", true, 3.0},
	    {"0x10", true, 16.0},
	    {"inf", true, std::numeric_limits<double>::infinity()},
	    {"1e400", true, std::numeric_limits<double>::infinity()},
	    {"5mm", false},
	    {"5 ", false},
	    {"", false},
	    {std::string("5\0", 2), false},
	};
	for (const auto& rRow : rows)
	{
		double wide = 7.0;
		EXPECT_EQ(FromText(rRow.m_Text, wide), rRow.m_bReads) << rRow.m_Text;
		EXPECT_EQ(wide, rRow.m_bReads ? rRow.m_Value : 7.0) << rRow.m_Text;
		float narrow = 7.0f;
		EXPECT_EQ(FromText(rRow.m_Text, narrow), rRow.m_bReads) << rRow.m_Text;
		EXPECT_EQ(narrow, rRow.m_bReads ? float(rRow.m_Value) : 7.0f) << rRow.m_Text;
	}
}

TEST(ParameterText, NineDigitsHoldAFloat)
{
	EXPECT_EQ(ToText(0.1f), "0.100000001");
	EXPECT_EQ(ToText(0.1), "0.1");
	EXPECT_EQ(ToText(1.0 / 3.0), "0.333333333");
	EXPECT_EQ(ToText(1e10), "1e+10");
	// By way of a double this one is rounded to the even neighbour: it lies just above the middle of two floats.
	float value = 0.0f;
	EXPECT_TRUE(FromText("1.00000005960464477540", value));
	EXPECT_EQ(value, std::nextafter(1.0f, 2.0f));
	for (const float sample : {1.0f / 3.0f, 1e-45f, std::numeric_limits<float>::max(), -16777217.0f, 8.5899346e9f,
	         std::numeric_limits<float>::infinity(), -std::numeric_limits<float>::infinity()})
	{
		EXPECT_TRUE(FromText(ToText(sample), value)) << sample;
		EXPECT_EQ(value, sample);
	}
	EXPECT_TRUE(FromText(ToText(std::nanf("")), value));
	EXPECT_TRUE(std::isnan(value));
}

TEST(ParameterText, IntegersAndBooleansRows)
{
	const struct
	{
		const char* m_pText;
		/// Beyond the type's range stands for a text that does not read.
		std::int64_t m_Signed;
		std::int64_t m_Unsigned;
	} rows[] = {
	    {"0", 0, 0},
	    {" 42", 42, 42},
	    {"+7", 7, 7},
	    {"-1", -1, -1},
	    {"2147483648", INT64_MAX, 2147483648},
	    {"4294967295", INT64_MAX, 4294967295},
	    {"4294967296", INT64_MAX, -1},
	    {"-2147483648", INT32_MIN, -1},
	    {"3x", INT64_MAX, -1},
	    {"3.0", INT64_MAX, -1},
	    {"+-3", INT64_MAX, -1},
	    {"", INT64_MAX, -1},
	};
	for (const auto& rRow : rows)
	{
		std::int32_t number = 0;
		EXPECT_EQ(FromText(rRow.m_pText, number), rRow.m_Signed != INT64_MAX) << rRow.m_pText;
		EXPECT_EQ(number, rRow.m_Signed == INT64_MAX ? 0 : rRow.m_Signed) << rRow.m_pText;
		std::uint32_t natural = 0;
		EXPECT_EQ(FromText(rRow.m_pText, natural), rRow.m_Unsigned != -1) << rRow.m_pText;
		EXPECT_EQ(natural, rRow.m_Unsigned == -1 ? 0 : rRow.m_Unsigned) << rRow.m_pText;
	}
	bool bValue = false;
	EXPECT_TRUE(FromText("true", bValue) && bValue);
	EXPECT_TRUE(FromText("0", bValue) && !bValue);
	EXPECT_TRUE(FromText("1", bValue) && bValue);
	EXPECT_TRUE(FromText(ToText(false), bValue) && !bValue);
	EXPECT_FALSE(FromText("yes", bValue));
	EXPECT_EQ(ToText(std::int32_t(-5)) + ToText(4294967295u), "-54294967295");
}

TEST(Parameter, IsValidRows)
{
	const float c_NaN = std::nanf("");
	const struct
	{
		const char* m_pName;
		std::optional<float> m_Value;
		std::optional<float> m_Default;
		bool m_bOptional;
		std::optional<float> m_Minimum;
		std::optional<float> m_Maximum;
		std::vector<float> m_Permitted;
		const char* m_pMessage;
	} rows[] = {
	    {"nothing", {}, {}, false, {}, {}, {}, "Value is not set"},
	    {"nothing, but limits", {}, {}, false, 1, 2, {}, "Value is not set"},
	    {"nothing, optional", {}, {}, true, {}, {}, {}, ""},
	    {"nothing, optional, with limits", {}, {}, true, 1, 2, {3}, ""},
	    {"a default", {}, 5, false, {}, {}, {}, ""},
	    {"a default out of range", {}, 5, false, 6, {}, {}, "Value is less than permitted minimum"},
	    {"the value counts, not the default", 7, 5, false, 6, {}, {}, ""},
	    {"at the minimum", 1, {}, false, 1, 2, {}, ""},
	    {"at the maximum", 2, {}, false, 1, 2, {}, ""},
	    {"below", 0.5f, {}, false, 1, 2, {}, "Value is less than permitted minimum"},
	    {"above", 2.5f, {}, false, 1, 2, {}, "Value is greater than permitted maximum"},
	    {"out of range and optional", 0, {}, true, 1, {}, {}, "Value is less than permitted minimum"},
	    {"limits the wrong way round", 1.5f, {}, false, 2, 1, {}, "Value is less than permitted minimum"},
	    {"not a number, with a maximum", c_NaN, {}, false, 1, 2, {}, "Value is greater than permitted maximum"},
	    {"not a number, with a minimum only", c_NaN, {}, false, 1, {}, {}, ""},
	    {"permitted", 2, {}, false, {}, {}, {1, 2}, ""},
	    {"not permitted", 3, {}, false, {}, {}, {1, 2}, "Value is not one of the permitted values"},
	    {"permitted, but out of range", 3, {}, false, {}, 2, {3}, "Value is greater than permitted maximum"},
	};
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		VParameterTyped<float> parameter("p");
		parameter.m_bOptional = rRow.m_bOptional;
		if (rRow.m_Default)
			parameter.SetDefault(*rRow.m_Default);
		if (rRow.m_Value)
			parameter.Set(*rRow.m_Value);
		if (rRow.m_Minimum)
			parameter.SetMinimum(*rRow.m_Minimum);
		if (rRow.m_Maximum)
			parameter.SetMaximum(*rRow.m_Maximum);
		for (const float permitted : rRow.m_Permitted)
			parameter.AddPermitted(ToText(permitted), permitted);
		std::string message = "from before";
		EXPECT_EQ(parameter.IsValid(message), rRow.m_pMessage[0] == '\0');
		EXPECT_EQ(message, rRow.m_pMessage);
	}
}

TEST(Parameter, AttributesSayOnlyWhatThereIsToSay)
{
	VParameterTyped<double> parameter("Weight");
	EXPECT_EQ(parameter.GetAttributes(), VAttributes());
	parameter.m_FriendlyName = "How heavy";
	parameter.m_Description = "Of the target";
	parameter.m_Category = "Solving";
	parameter.m_bAdvanced = parameter.m_bHidden = true;
	parameter.m_bSerialised = false;
	parameter.m_FileFilter = "*.qrs";
	parameter.SetMinimum(0.1);
	parameter.SetMaximum(100.0);
	parameter.SetDefault(1.0);
	parameter.Set(50.0);
	VAttributes expected{{"<FriendlyName>", "How heavy"}, {"<RangeMin>", "0.1"}, {"<RangeMax>", "100"},
	    {"<DefaultValue>", "1"}, {"<Description>", "Of the target"}, {"<Category>", "Solving"}, {"<Advanced>", "true"},
	    {"<Hidden>", "true"}, {"<Serialized>", "false"}, {"<FileFilter>", "*.qrs"}};
	EXPECT_EQ(parameter.GetAttributes(), expected);
	using TesselPluginInterface::EFileAccess;
	for (const auto& [access, text] : {std::pair{EFileAccess::EFolder, "Folder"}, {EFileAccess::ELoad, "Load"},
	         {EFileAccess::ESave, "Save"}, {EFileAccess::ELoadMultiple, "LoadMultiple"}})
	{
		parameter.m_FileAccess = access;
		expected["<FileAccess>"] = text;
		EXPECT_EQ(parameter.GetAttributes(), expected);
	}
}

TEST(Parameter, LivesInAVariable)
{
	float variable = 3.0f;
	VParameterTyped<float> parameter("p", &variable);
	EXPECT_FALSE(parameter.IsSet());
	EXPECT_EQ(parameter.GetText(), "") << "nobody has set it";
	parameter.SetDefault(4.0f);
	EXPECT_EQ(variable, 4.0f);
	EXPECT_EQ(parameter.GetText(), "4");
	EXPECT_TRUE(parameter.SetText("5.25"));
	EXPECT_EQ(variable, 5.25f);
	const std::uint64_t counter = parameter.ChangeCounter();
	EXPECT_FALSE(parameter.SetText("6mm"));
	parameter.Set(5.25f);
	EXPECT_EQ(parameter.ChangeCounter(), counter) << "nothing changed";
	EXPECT_EQ(variable, 5.25f);
	parameter.SetDefault(1.0f);
	EXPECT_EQ(variable, 5.25f) << "a value that is set stays";

	const std::unique_ptr<VParameter> pCopy = parameter.Clone();
	parameter.Reset();
	EXPECT_EQ(variable, 1.0f);
	EXPECT_EQ(pCopy->GetText(), "5.25") << "has a variable of its own";
	EXPECT_TRUE(pCopy->SetText("9"));
	EXPECT_EQ(variable, 1.0f);
	EXPECT_TRUE(parameter.SetFrom(*pCopy));
	EXPECT_EQ(variable, 9.0f);
}

TEST(Parameter, TakesFromOtherTypesByText)
{
	VParameterTyped<std::string> text("t");
	VParameterTyped<std::uint32_t> number("n");
	EXPECT_FALSE(number.SetFrom(text)) << "nothing to take";
	text.SetDefault("12");
	EXPECT_TRUE(number.SetFrom(text));
	EXPECT_EQ(number.Get(), 12u);
	text.Set("twelve");
	EXPECT_FALSE(number.SetFrom(text));
	EXPECT_EQ(number.Get(), 12u);
	EXPECT_TRUE(text.SetFrom(number));
	EXPECT_EQ(text.Get(), "12");
}

TEST(Parameter, PermittedTextsStandForTheirValues)
{
	VParameterTyped<std::int32_t> parameter("p");
	parameter.AddPermitted("None", 0);
	parameter.AddPermitted("All", 7);
	EXPECT_EQ(parameter.PermittedTexts(), (std::vector<std::string>{"None", "All"}));
	EXPECT_TRUE(parameter.SetText("All"));
	EXPECT_EQ(parameter.GetText(), "7");
	EXPECT_TRUE(parameter.SetText("3"));
	std::string message;
	EXPECT_FALSE(parameter.IsValid(message)) << "reads, and is told as not permitted";
	EXPECT_FALSE(parameter.SetText("Some"));
	EXPECT_EQ(parameter.Get(), 3);
	EXPECT_EQ(parameter.Type(), typeid(std::int32_t));
}

} // namespace
