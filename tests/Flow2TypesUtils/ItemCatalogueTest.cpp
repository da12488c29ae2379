#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectApplicationData.h"
#include "CoreOrlexTypes/SubjectState.h"
#include "Flow2TypesUtils/FlowParametersItem.h"
#include "Flow2TypesUtils/ItemTypes.h"
#include "Flow2TypesUtils/TaggedCoreTypeExtractor.h"
#include "InMemoryHost/PluginContext.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <thread>

namespace
{

using namespace Flow2TypesUtils;
using CoreOrlexTypes::VSubject;
using CoreOrlexTypes::VSubjectApplicationData;
using CoreOrlexTypes::VSubjectParametrised;
using TesselPluginInterface::SetItemValue;

const struct
{
	const char* m_pName;
	const char* m_pText;
	std::uint32_t m_Tag;
	/// S subject, P parametrised, A application data, D pose, T settings, L labels, blank for bytes.
	char m_Carries = ' ';
} c_Rows[] = {
    {"FlowCameraHardware", "CameraHardware Item", 4096},
    {"FlowCameraSettings", "CameraSettings Item", 4097},
    {"FlowCameraMaskGrid", "CameraMaskGrid Item", 4098},
    {"FlowCentroidSet", "CentroidSet Item", 4099},
    {"FlowGreyscaleBlobSet", "GreyscaleBlobSet Item", 4101},
    {"FlowEdgePairSet", "EdgePairSet Item", 4102},
    {"FlowVideoFrame", "VideoFrame Item", 4103},
    {"FlowCameraCalibration", "CameraCalibration Item", 4106},
    {"FlowCentroidAssignmentSet", "CentroidAssignmentSet Item", 4108},
    {"FlowReconstructionSet", "ReconstructionSet Item", 4109},
    {"FlowReconstructionTrackSet", "ReconstructionTrackSet Item", 4110},
    {"FlowReconstructionLabelSet", "ReconstructionLabelSet Item", 4111, 'L'},
    {"FlowSubjectDynamicParameters", "SubjectDynamicParameters Item", 4113, 'D'},
    {"FlowSubject", "Subject Item", 4114, 'S'},
    {"FlowSubjectApplicationData", "SubjectApplicationData Item", 4115, 'A'},
    {"FlowSubjectParametrised", "SubjectParametrised Item", 4122, 'P'},
    {"FlowSubjectForSolving", "Subject Item", 4123, 'S'},
    {"FlowSubjectApplicationDataForSolving", "SubjectApplicationData Item", 4124, 'A'},
    {"FlowSubjectDynamicParametersForSolving", "SubjectDynamicParameters Item", 4125, 'D'},
    {"FlowReconstructionSetForSolving", "ReconstructionSet Item", 4126},
    {"FlowReconstructionLabelSetForSolving", "ReconstructionLabelSet Item", 4127, 'L'},
    {"FlowCentroidLabelSet", "CentroidLabelSet Item", 4130},
    {"FlowDevice", "Device Item", 4131},
    {"FlowDeviceApplicationData", "DeviceApplicationData Item", 4132},
    {"FlowDeviceSamples", "DeviceSamples Item", 4133},
    {"FlowSubjectSettings", "SubjectSettings Item", 4135, 'T'},
    {"FlowSubjectTemplate", "Uncalibrated subject template item", 4138, 'P'},
    {"FlowSubjectParametrisedForSolving", "SubjectParametrised for second solve item", 4140, 'P'},
    {"FlowCameraPhysicalSensorData", "CameraPhysicalSensorData Item", 4142},
    {"FlowSubjectTemplateForSolving", "Uncalibrated solving subject template item", 4144, 'P'},
    {"FlowVolumeProperties", "VolumeProperties Item", 4145},
    {"FlowLabelledRotationSet", "LabelledRotationSet Item", 4147},
    {"FlowRigidObjectDynamicParameters", "RigidObjectDynamicParameters Item", 4148, 'D'},
    {"FlowRigidObject", "Rigid Object Item", 4149, 'S'},
    {"FlowRigidObjectApplicationData", "RigidObjectApplicationData Item", 4150, 'A'},
    {"FlowSubjectForRetargeting", "SubjectForRetargeting Item", 4152, 'S'},
    {"FlowSubjectApplicationDataForRetargeting", "SubjectApplicationDataForRetargeting Item", 4153, 'A'},
    {"FlowSubjectDynamicParametersForRetargeting", "SubjectDynamicParametersForRetargeting Item", 4154, 'D'},
    {"FlowSubjectTemplateForRetargeting", "Uncalibrated retargeting subject template item", 4156, 'P'},
    {"FlowLabelledRotationSetForSolving", "LabelledRotationSetForSolving Item", 4160},
    {"FlowSmartObject", "Smart Object Item", 4164},
};

/// Puts a value of each type into a new item of the row's flow type and asks the extractor for it by the row's tag.
template <typename T>
bool Passes(const char* i_pName, std::uint32_t i_Tag)
{
	InMemoryHost::VPluginContext host;
	const auto pItem = host.GetItemFactory()->CreateItem(i_pName);
	const auto pValue = std::make_shared<const T>();
	if (!SetItemValue(pItem, pValue))
		return false;
	const auto pFrame = host.GetFrameFactory()->CreateFrame();
	pFrame->AddItem(pItem);
	VTaggedCoreTypeExtractor extractor;
	EXPECT_TRUE(extractor.Insert(i_Tag));
	EXPECT_TRUE(extractor.Update(*pFrame));
	return extractor.Get<T>(i_Tag) == pValue && extractor.Get(i_Tag) == pValue;
}

TEST(ItemCatalogue, Rows)
{
	const std::span<const VItemDescriptor> catalogue = ItemCatalogue();
	ASSERT_EQ(catalogue.size(), 41u);
	ASSERT_EQ(std::size(c_Rows), 41u);
	for (std::size_t i = 0; i < catalogue.size(); ++i)
	{
		const auto& rRow = c_Rows[i];
		SCOPED_TRACE(rRow.m_pName);
		EXPECT_EQ(catalogue[i].m_Name, rRow.m_pName);
		EXPECT_EQ(catalogue[i].m_Text, rRow.m_pText);
		EXPECT_EQ(catalogue[i].m_Tag, rRow.m_Tag);
		EXPECT_EQ(catalogue[i].m_Version, 1u);
		EXPECT_EQ(catalogue[i].m_Count, 0u);
		EXPECT_EQ(FindItemType(rRow.m_Tag), &catalogue[i]);
		EXPECT_EQ(FindItemType(rRow.m_pName), &catalogue[i]);
		EXPECT_EQ(Passes<VSubject>(rRow.m_pName, rRow.m_Tag), rRow.m_Carries == 'S');
		EXPECT_EQ(Passes<VSubjectParametrised>(rRow.m_pName, rRow.m_Tag), rRow.m_Carries == 'P');
		EXPECT_EQ(Passes<VSubjectApplicationData>(rRow.m_pName, rRow.m_Tag), rRow.m_Carries == 'A');
		EXPECT_EQ(Passes<CoreOrlexTypes::VSubjectDynamicParameters>(rRow.m_pName, rRow.m_Tag), rRow.m_Carries == 'D');
		EXPECT_EQ(Passes<CoreOrlexTypes::VSubjectSettings>(rRow.m_pName, rRow.m_Tag), rRow.m_Carries == 'T');
		EXPECT_EQ(Passes<CoreOrlexTypes::VReconstructionLabelSet>(rRow.m_pName, rRow.m_Tag), rRow.m_Carries == 'L');
		EXPECT_EQ(Passes<VItemBytes>(rRow.m_pName, rRow.m_Tag), rRow.m_Carries == ' ');
	}
}

TEST(ItemCatalogue, TagsIdentifyAndTextsDoNot)
{
	EXPECT_EQ(FindItemType("FlowSubject")->m_Text, FindItemType("FlowSubjectForSolving")->m_Text);
	EXPECT_NE(FindItemType("FlowSubject")->m_Tag, FindItemType("FlowSubjectForSolving")->m_Tag);
	for (const std::uint32_t tag : {0u, 4095u, 4100u, 4161u, 4165u, 0xFFFFFFFFu})
		EXPECT_EQ(FindItemType(tag), nullptr) << tag;
	EXPECT_EQ(FindItemType("Subject Item"), nullptr);
	EXPECT_EQ(FindItemType(FlowParametersItem::c_pName), nullptr) << "parameters have no tag";
}

TEST(ItemCatalogue, IsMadeOnceWhoeverAsksFirst)
{
	std::vector<const VItemDescriptor*> found(8);
	std::vector<std::thread> threads;
	for (const VItemDescriptor*& rpFound : found)
		threads.emplace_back([&rpFound] { rpFound = FindItemType(4164); });
	for (std::thread& rThread : threads)
		rThread.join();
	EXPECT_EQ(std::count(found.begin(), found.end(), FindItemType("FlowSmartObject")), 8);
}

} // namespace
