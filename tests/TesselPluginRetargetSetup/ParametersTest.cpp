// The panel's parameters: what they are called, where their values come from.

#include "../LogRecorder.h"
#include "../UtilsFileSystem/Folder.h"
#include "TestHost.h"

#include "TesselParameters/ParameterGroup.h"
#include "TesselParametersGUI/ParameterFBX.h"
#include "TesselPluginInterface/IParameter.h"
#include "TesselPluginRetargetSetup/PanelParameters.h"

#include <gtest/gtest.h>

namespace
{

namespace fs = boost::filesystem;
using RetargetSetup::VPanelParameters;
using TesselDataStore::ToVariant;
using namespace TesselPluginInterface;

class PanelParameters : public testing::Test
{
protected:
	fs::path Touch(const std::string& i_rFile)
	{
		const fs::path file = m_Root / i_rFile;
		fs::create_directories(file.parent_path());
		Put(file, "x");
		return file;
	}

	VPanelParameters Make(const RetargetSetup::VProductFolders& i_rInstalled = {})
	{
		return VPanelParameters(m_Context.m_pStore, *m_Context.m_pRegistry, m_Context.Folders(), i_rInstalled);
	}

	static std::vector<std::string> Names(const IParameter& i_rParameter)
	{
		std::vector<std::string> names;
		for (const VEnumEntry& rEntry : i_rParameter.GetEnumeration())
			names.push_back(rEntry.m_Name);
		return names;
	}

	const VTestFolder m_Root;
	VTestContext m_Context;
};

TEST_F(PanelParameters, AreCalledAndLimitedSo)
{
	struct VRow
	{
		const char* m_pGroup;
		const char* m_pKey;
		EValueKind m_Kind;
		NVX::IO::VSchemaPointer m_pSchema;
		const char* m_pDisplay;
		const char* m_pDescription;
		NVX::IO::VVariant m_Default;
		bool m_bEnumerated = false;
		NVX::IO::VVariant m_Minimum = {};
		NVX::IO::VVariant m_Maximum = {};
		EPresentationHint m_Hint = EPresentationHint::EDontCare;
	};
	const auto text = TesselDataStore::SchemaOf<std::string>();
	const auto real = TesselDataStore::SchemaOf<double>();
	const VRow rows[] = {
	    {"Subject", "SourceSkeleton", EValueKind::EText, text, "Source Skeleton", "Orlex skeleton driving targets.", {},
	        true},
	    {"Subject", "SourceSkin", EValueKind::EPath, TesselDataStore::SchemaOf<fs::path>(), "Source Skin",
	        "Skin file for source skeleton.", {}, true},
	    {"Subject", "TargetFBX", EValueKind::EText, text, "Target FBX", "Skin file for target skeleton.", {}, true},
	    {"Subject", "TargetRoot", EValueKind::EInteger, TesselDataStore::SchemaOf<std::uint32_t>(), "Target Root",
	        "Root bone for target skeleton", {}, true},
	    {"Subject", "TargetScale", EValueKind::EReal, real, "Target Scale", "Global scale to apply to target skeleton",
	        ToVariant(1.0)},
	    {"Target", "TargetWeight", EValueKind::EReal, real, "Weight", "Skin file for target skeleton.", {}, false,
	        ToVariant(1.0), ToVariant(100.0), EPresentationHint::ESlider},
	    {"Target", "TargetStateExpressionX", EValueKind::EText, text, "State X", "State expression for target X", {}},
	    {"Target", "TargetStateExpressionY", EValueKind::EText, text, "State Y", "State expression for target Y", {}},
	    {"Target", "TargetStateExpressionZ", EValueKind::EText, text, "State Z", "State expression for target Z", {}},
	};
	const VPanelParameters parameters = Make();
	std::map<std::string, std::size_t> places;
	for (const VRow& rRow : rows)
	{
		SCOPED_TRACE(rRow.m_pKey);
		const auto pGroup = m_Context.m_pRegistry->Find("RetargetSetup", rRow.m_pGroup);
		ASSERT_TRUE(pGroup);
		const std::size_t place = places[rRow.m_pGroup]++;
		ASSERT_LT(place, pGroup->GetParameters().size());
		const IParameter& rParameter = *pGroup->GetParameters()[place];
		EXPECT_EQ(rParameter.GetName(), rRow.m_pKey);
		EXPECT_EQ(rParameter.GetStoreKey(), std::string("RetargetSetup/") + rRow.m_pKey);
		EXPECT_EQ(rParameter.GetValueKind(), rRow.m_Kind);
		EXPECT_EQ(rParameter.GetSchema(), rRow.m_pSchema);
		EXPECT_EQ(rParameter.GetDisplay(), rRow.m_pDisplay);
		EXPECT_EQ(rParameter.GetDescription(), rRow.m_pDescription);
		EXPECT_EQ(rParameter.GetDefault(), rRow.m_Default);
		EXPECT_EQ(rParameter.HasValue(), rParameter.HasDefault());
		EXPECT_EQ(rParameter.HasEnumeration(), rRow.m_bEnumerated);
		EXPECT_EQ(rParameter.GetMinimum(), rRow.m_Minimum);
		EXPECT_EQ(rParameter.GetMaximum(), rRow.m_Maximum);
		EXPECT_EQ(rParameter.GetPresentationHint(), rRow.m_Hint);
		EXPECT_EQ(rParameter.GetFlags(), 0u);
	}
	for (const auto& [rGroup, count] : places)
		EXPECT_EQ(m_Context.m_pRegistry->Find("RetargetSetup", rGroup)->GetParameters().size(), count) << rGroup;
}

TEST_F(PanelParameters, OfferTheFilesOfTheirFolders)
{
	const fs::path subjects = Touch("subjects/Anna.qrs").parent_path();
	Touch("subjects/Both.qrs");
	Touch("subjects/Anna.qrr");
	const fs::path user = Touch("user/Both.qrs").parent_path();
	const fs::path models = Touch("models/Zoe.qrs").parent_path();
	const fs::path skins = Touch("skins/OrlexFemale.fbx").parent_path();
	Touch("skins/dragon.fbx");
	const fs::path ownSkins = Touch("own/dragon.fbx").parent_path();
	m_Context.Folders().SetFolder("FolderSubjects", subjects);
	m_Context.Folders().SetFolder("FolderSubjectCalTemplates", user);
	m_Context.Folders().SetFolder("FolderSkins", ownSkins);

	VPanelParameters parameters = Make({{models}, {skins}});
	EXPECT_EQ(Names(*parameters.m_pSourceSkeleton), (std::vector<std::string>{"Anna", "Both", "Zoe"}));
	EXPECT_EQ(parameters.m_pSourceSkeleton->GetEnumeration()[1].m_Value, ToVariant((subjects / "Both.qrs").string()));
	EXPECT_EQ(Names(*parameters.m_pSourceSkin), (std::vector<std::string>{"(None)", "OrlexFemale"}));
	EXPECT_EQ(Names(*parameters.m_pTargetFBX), (std::vector<std::string>{"(None)", "dragon", "OrlexFemale"}));
	EXPECT_EQ(parameters.m_pTargetFBX->GetEnumeration()[1].m_Value, ToVariant((ownSkins / "dragon.fbx").string()));

	struct VFolder
	{
		const char* m_pLabel;
		fs::path m_Folder;
		int m_Priority;
	};
	const auto expectFolders = [](const TesselParametersGUI::VParameterEnumFolderWatcher& i_rParameter,
	                               const std::vector<VFolder>& i_rExpected)
	{
		ASSERT_EQ(i_rParameter.GetFolders().size(), i_rExpected.size());
		for (std::size_t i = 0; i < i_rExpected.size(); ++i)
		{
			EXPECT_EQ(i_rParameter.GetFolders()[i].m_Label, i_rExpected[i].m_pLabel);
			EXPECT_EQ(i_rParameter.GetFolders()[i].m_Folder, i_rExpected[i].m_Folder);
			EXPECT_EQ(i_rParameter.GetFolders()[i].m_Priority, i_rExpected[i].m_Priority);
		}
	};
	expectFolders(
	    *parameters.m_pSourceSkeleton, {{"Subjects", subjects, 11}, {"User", user, 10}, {"Installed0", models, 1}});
	expectFolders(*parameters.m_pTargetFBX, {{"User", ownSkins, 10}, {"Installed0", skins, 1}});
	expectFolders(*parameters.m_pSourceSkin, {{"Installed0", skins, 1}});

	m_Context.Folders().SetFolder("FolderSubjects", models);
	parameters.OnFolderPreferenceChanged("FolderSubjects", m_Context.Folders());
	expectFolders(
	    *parameters.m_pSourceSkeleton, {{"Subjects", models, 11}, {"User", user, 10}, {"Installed0", models, 1}});
	EXPECT_EQ(Names(*parameters.m_pSourceSkeleton), (std::vector<std::string>{"Both", "Zoe"}));
}

TEST_F(PanelParameters, BeginWithTheClusterTemplateWhereNothingValidIsStored)
{
	const fs::path folder = Touch("subjects/ClusterTemplate.qrs").parent_path();
	const fs::path other = Touch("subjects/Other.qrs");
	const fs::path elsewhere = Touch("elsewhere/Far.qrs");
	m_Context.Folders().SetFolder("FolderSubjects", folder);
	const auto begins = [this](const char* i_pStored)
	{
		if (i_pStored)
			Make().m_pSourceSkeleton->Set(i_pStored);
		return fs::path(Make().m_pSourceSkeleton->GetValueText()).filename().string();
	};
	EXPECT_EQ(begins(nullptr), "ClusterTemplate.qrs");
	EXPECT_EQ(begins(other.c_str()), "Other.qrs");
	EXPECT_EQ(begins((m_Root / "gone.qrs").c_str()), "ClusterTemplate.qrs");
	{
		VLogRecorder errors(NVX::ELogError);
		EXPECT_EQ(begins("performer"), "ClusterTemplate.qrs") << "a target subject told it in an earlier run";
		EXPECT_EQ(errors.Take(), "");
	}
	EXPECT_EQ(begins(elsewhere.c_str()), "Far.qrs");
	EXPECT_EQ(Names(*Make().m_pSourceSkeleton), (std::vector<std::string>{"ClusterTemplate", "Far", "Other"}))
	    << "the folder of a file from elsewhere is watched, too";
}

} // namespace
