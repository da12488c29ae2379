#include "TesselParameters/Attributes.h"
#include "TesselParameters/ParameterGroup.h"

#include "InMemoryHost/Dispatcher.h"

#include <gtest/gtest.h>

namespace
{

using namespace TesselParameters;
using namespace TesselPluginInterface;
using TesselDataStore::SchemaOf;
using TesselDataStore::ToVariant;
using VTexts = std::vector<std::string>;

VTexts Names(const NVX::IO::ISchema& i_rSchema)
{
	VTexts names;
	for (const NVX::IO::VSchemaChild& rChild : i_rSchema.m_Children)
		names.push_back(rChild.m_Name);
	return names;
}

TEST(Attributes, StandInTheirOrder)
{
	const auto pSchema = AttributesSchema(SchemaOf<double>());
	EXPECT_EQ(pSchema->m_Name, "Attributes");
	EXPECT_EQ(Names(*pSchema),
	    (VTexts{"Category", "Display", "Description", "PresentationHint", "DataConversionHint", "FileAccess",
	        "FileFilter", "ValidatorRegEx", "Hidden", "Advanced", "Dynamic", "Default", "Min", "Max", "Enum"}));
	const NVX::IO::ISchema& rHint = *pSchema->m_Children[3].m_pSchema;
	EXPECT_EQ(rHint.m_Name, "Parameter.PresentationHint.Enum");
	EXPECT_EQ(
	    Names(rHint), (VTexts{"DontCare", "Slider", "MultiLine", "CheckableOption", "CheckableSlider", "Colour"}));
	const NVX::IO::ISchema& rConversion = *pSchema->m_Children[4].m_pSchema;
	EXPECT_EQ(rConversion.m_Name, "Parameter.DataConversionHint.Enum");
	EXPECT_EQ(Names(rConversion), (VTexts{"NoConversion", "SecondsToTick135", "MillisecondsToTick135"}));
	const NVX::IO::ISchema& rAccess = *pSchema->m_Children[5].m_pSchema;
	EXPECT_EQ(rAccess.m_Name, "Parameter.FileAccess.Enum");
	EXPECT_EQ(Names(rAccess), (VTexts{"None", "Folder", "Save", "Load", "LoadMultiple"}));
	for (const NVX::IO::ISchema* const pEnumeration : {&rHint, &rConversion, &rAccess})
		for (std::size_t index = 0; index < pEnumeration->m_Children.size(); ++index)
			EXPECT_EQ(pEnumeration->m_Children[index].m_Value, std::int64_t(index));
	EXPECT_EQ(pSchema->m_Children[11].m_pSchema, SchemaOf<double>());
	EXPECT_EQ(pSchema->m_Children[14].m_pSchema, EnumerationSchema(SchemaOf<double>()));
}

/// What a control sees of a parameter, each attribute in turn.
VTexts Described(const IParameter& i_rParameter)
{
	const auto number = [](auto i_Value) { return std::to_string(std::uint32_t(i_Value)); };
	VTexts texts{i_rParameter.GetCategory(), i_rParameter.GetDisplay(), i_rParameter.GetDescription(),
	    number(i_rParameter.GetPresentationHint()), number(i_rParameter.GetDataConversionHint()),
	    number(i_rParameter.GetFileAccess()), i_rParameter.GetFileFilter(), i_rParameter.GetValidatorRegEx(),
	    number(i_rParameter.GetFlags()), i_rParameter.ToText(i_rParameter.GetDefault()),
	    i_rParameter.ToText(i_rParameter.GetMinimum()), i_rParameter.ToText(i_rParameter.GetMaximum())};
	for (const VEnumEntry& rEntry : i_rParameter.GetEnumeration())
		texts.push_back(rEntry.m_Name + '=' + i_rParameter.ToText(rEntry.m_Value));
	return texts;
}

TEST(Attributes, EachIsKeptAndToldAlone)
{
	const std::vector<VEnumEntry> entries{{"one", ToVariant(1.0)}, {"", ToVariant(0.5)}};
	using VSet = std::function<void(IParameter&)>;
	const struct
	{
		const char* m_pName;
		VSet m_Set;
		std::size_t m_Index;
		const char* m_pText;
	} rows[] = {
	    {"category", [](IParameter& io_rParameter) { io_rParameter.SetCategory("c"); }, 0, "c"},
	    {"display", [](IParameter& io_rParameter) { io_rParameter.SetDisplay("d"); }, 1, "d"},
	    {"description", [](IParameter& io_rParameter) { io_rParameter.SetDescription("e"); }, 2, "e"},
	    {"presentation",
	        [](IParameter& io_rParameter) { io_rParameter.SetPresentationHint(EPresentationHint::ESlider); }, 3, "1"},
	    {"conversion",
	        [](IParameter& io_rParameter)
	        { io_rParameter.SetDataConversionHint(EDataConversionHint::EMillisecondsToTick135); },
	        4, "2"},
	    {"access", [](IParameter& io_rParameter) { io_rParameter.SetFileAccess(EFileAccess::ELoad); }, 5, "3"},
	    {"filter", [](IParameter& io_rParameter) { io_rParameter.SetFileFilter("*.qrs"); }, 6, "*.qrs"},
	    {"expression", [](IParameter& io_rParameter) { io_rParameter.SetValidatorRegEx("a+"); }, 7, "a+"},
	    {"hidden", [](IParameter& io_rParameter) { io_rParameter.SetFlag(IParameter::EHidden, true); }, 8, "1"},
	    {"advanced", [](IParameter& io_rParameter) { io_rParameter.SetFlag(IParameter::EAdvanced, true); }, 8, "2"},
	    {"dynamic", [](IParameter& io_rParameter) { io_rParameter.SetFlag(IParameter::EDynamic, true); }, 8, "4"},
	    {"default", [](IParameter& io_rParameter) { io_rParameter.SetValueDefault(ToVariant(0.1)); }, 9, "0.1"},
	    {"minimum", [](IParameter& io_rParameter) { io_rParameter.SetMinimum(ToVariant(-1.0)); }, 10, "-1"},
	    {"maximum", [](IParameter& io_rParameter) { io_rParameter.SetMaximum(ToVariant(1e30)); }, 11, "1e+30"},
	    {"permitted", [&](IParameter& io_rParameter) { io_rParameter.SetEnumeration(entries); }, 12, "one=1"},
	};
	const VTexts unset{"", "", "", "0", "0", "0", "", "", "0", "", "", ""};
	const auto pDispatcher = std::make_shared<InMemoryHost::VDispatcher>();
	for (const auto& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pName);
		VParameterGroup group(nullptr, "Path", "Group");
		const auto pParameter = group.Add<double>("Name");
		EXPECT_EQ(Described(*pParameter), unset);
		EXPECT_FALSE(pParameter->HasEnumeration());
		int told = 0;
		pParameter->ConnectAttributes([&] { told = 1; }, pDispatcher);
		rRow.m_Set(*pParameter);
		VTexts expected = unset;
		if (rRow.m_Index == unset.size())
			expected.insert(expected.end(), {rRow.m_pText, "=0.5"});
		else
			expected[rRow.m_Index] = rRow.m_pText;
		EXPECT_EQ(Described(*pParameter), expected);
		EXPECT_EQ(pParameter->HasEnumeration(), rRow.m_Index == unset.size());
		pDispatcher->RunPending();
		EXPECT_EQ(std::exchange(told, 0), 1);
		rRow.m_Set(*pParameter);
		EXPECT_EQ(pDispatcher->PendingCount(), 0u);
	}
}

TEST(Attributes, ValuesOfAnotherTypeAreRefused)
{
	VParameterGroup group(nullptr, "Path", "Group");
	const auto pParameter = group.Add<double>("Name");
	const NVX::IO::VVariant wrong = ToVariant<std::uint32_t>(1);
	EXPECT_FALSE(pParameter->SetValueDefault(wrong));
	EXPECT_FALSE(pParameter->SetMinimum(wrong));
	EXPECT_FALSE(pParameter->SetMaximum(wrong));
	EXPECT_FALSE(pParameter->SetEnumeration({{"right", ToVariant(1.0)}, {"wrong", wrong}}));
	EXPECT_FALSE(pParameter->HasDefault());
	EXPECT_FALSE(pParameter->HasEnumeration());
	EXPECT_TRUE(pParameter->SetEnumeration({}));
	EXPECT_TRUE(pParameter->HasEnumeration());
}

TEST(ParameterGroup, KeepsOrderAndTellsItsEnd)
{
	VTexts told;
	const auto pChild = std::make_shared<VParameterGroup>(nullptr, "Path", "Child");
	{
		VParameterGroup group(nullptr, "RetargetSetup", "Subject");
		group.ChangedSignal().Connect([&] { told.push_back("changed"); });
		group.EndingSignal().Connect([&] { told.push_back("ending " + group.GetName()); });
		EXPECT_EQ(group.GetDisplay(), "Subject");
		group.SetDisplay("Of the subject");
		group.SetDescription("What it is made of.");
		EXPECT_EQ(group.GetDisplay(), "Of the subject");
		EXPECT_EQ(group.GetDescription(), "What it is made of.");
		group.Add<double>("b", "Label", "Text");
		group.Add<bool>("a");
		group.AddChild(pChild);
		ASSERT_EQ(group.GetParameters().size(), 2u);
		EXPECT_EQ(group.GetParameters()[0]->GetStoreKey(), "RetargetSetup/b");
		EXPECT_EQ(group.GetParameters()[0]->GetDisplay(), "Label");
		EXPECT_EQ(group.GetParameters()[0]->GetDescription(), "Text");
		EXPECT_EQ(group.Find("a"), group.GetParameters()[1]);
		EXPECT_EQ(group.Find("c"), nullptr);
		EXPECT_EQ(group.GetChildren().size(), 1u);
	}
	EXPECT_EQ(told, (VTexts{"changed", "changed", "changed", "ending Subject"}));
}

} // namespace
