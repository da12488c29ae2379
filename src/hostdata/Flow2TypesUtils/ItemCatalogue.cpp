#include "Flow2TypesUtils/ItemCatalogue.h"

#include <algorithm>
#include <vector>

namespace Flow2TypesUtils
{

namespace
{

std::vector<VItemDescriptor> MakeCatalogue()
{
	using enum EItemValue;
	constexpr struct
	{
		std::uint32_t m_Tag;
		const char* m_pName;
		const char* m_pText;
		EItemValue m_Value = EBytes;
	} c_Rows[] = {
	    {4096, "FlowCameraHardware", "CameraHardware Item"},
	    {4097, "FlowCameraSettings", "CameraSettings Item"},
	    {4098, "FlowCameraMaskGrid", "CameraMaskGrid Item"},
	    {4099, "FlowCentroidSet", "CentroidSet Item"},
	    {4101, "FlowGreyscaleBlobSet", "GreyscaleBlobSet Item"},
	    {4102, "FlowEdgePairSet", "EdgePairSet Item"},
	    {4103, "FlowVideoFrame", "VideoFrame Item"},
	    {4106, "FlowCameraCalibration", "CameraCalibration Item"},
	    {4108, "FlowCentroidAssignmentSet", "CentroidAssignmentSet Item"},
	    {4109, "FlowReconstructionSet", "ReconstructionSet Item"},
	    {4110, "FlowReconstructionTrackSet", "ReconstructionTrackSet Item"},
	    {4111, "FlowReconstructionLabelSet", "ReconstructionLabelSet Item", EReconstructionLabelSet},
	    {4113, "FlowSubjectDynamicParameters", "SubjectDynamicParameters Item", ESubjectDynamicParameters},
	    {4114, "FlowSubject", "Subject Item", ESubject},
	    {4115, "FlowSubjectApplicationData", "SubjectApplicationData Item", ESubjectApplicationData},
	    {4122, "FlowSubjectParametrised", "SubjectParametrised Item", ESubjectParametrised},
	    {4123, "FlowSubjectForSolving", "Subject Item", ESubject},
	    {4124, "FlowSubjectApplicationDataForSolving", "SubjectApplicationData Item", ESubjectApplicationData},
	    {4125, "FlowSubjectDynamicParametersForSolving", "SubjectDynamicParameters Item", ESubjectDynamicParameters},
	    {4126, "FlowReconstructionSetForSolving", "ReconstructionSet Item"},
	    {4127, "FlowReconstructionLabelSetForSolving", "ReconstructionLabelSet Item", EReconstructionLabelSet},
	    {4130, "FlowCentroidLabelSet", "CentroidLabelSet Item"},
	    {4131, "FlowDevice", "Device Item"},
	    {4132, "FlowDeviceApplicationData", "DeviceApplicationData Item"},
	    {4133, "FlowDeviceSamples", "DeviceSamples Item"},
	    {4135, "FlowSubjectSettings", "SubjectSettings Item", ESubjectSettings},
	    {4138, "FlowSubjectTemplate", "Uncalibrated subject template item", ESubjectParametrised},
	    {4140, "FlowSubjectParametrisedForSolving", "SubjectParametrised for second solve item", ESubjectParametrised},
	    {4142, "FlowCameraPhysicalSensorData", "CameraPhysicalSensorData Item"},
	    {4144, "FlowSubjectTemplateForSolving", "Uncalibrated solving subject template item", ESubjectParametrised},
	    {4145, "FlowVolumeProperties", "VolumeProperties Item"},
	    {4147, "FlowLabelledRotationSet", "LabelledRotationSet Item"},
	    {4148, "FlowRigidObjectDynamicParameters", "RigidObjectDynamicParameters Item", ESubjectDynamicParameters},
	    {4149, "FlowRigidObject", "Rigid Object Item", ESubject},
	    {4150, "FlowRigidObjectApplicationData", "RigidObjectApplicationData Item", ESubjectApplicationData},
	    {4152, "FlowSubjectForRetargeting", "SubjectForRetargeting Item", ESubject},
	    {4153, "FlowSubjectApplicationDataForRetargeting", "SubjectApplicationDataForRetargeting Item",
	        ESubjectApplicationData},
	    {4154, "FlowSubjectDynamicParametersForRetargeting", "SubjectDynamicParametersForRetargeting Item",
	        ESubjectDynamicParameters},
	    {4156, "FlowSubjectTemplateForRetargeting", "Uncalibrated retargeting subject template item",
	        ESubjectParametrised},
	    {4160, "FlowLabelledRotationSetForSolving", "LabelledRotationSetForSolving Item"},
	    {4164, "FlowSmartObject", "Smart Object Item"},
	};
	std::vector<VItemDescriptor> catalogue;
	catalogue.reserve(std::size(c_Rows));
	for (const auto& rRow : c_Rows)
		catalogue.push_back(
		    {.m_Text = rRow.m_pText, .m_Name = rRow.m_pName, .m_Tag = rRow.m_Tag, .m_Value = rRow.m_Value});
	return catalogue;
}

} // namespace

std::span<const VItemDescriptor> ItemCatalogue()
{
	static const std::vector<VItemDescriptor> s_Catalogue = MakeCatalogue();
	return s_Catalogue;
}

const VItemDescriptor* FindItemType(std::uint32_t i_Tag)
{
	const std::span<const VItemDescriptor> catalogue = ItemCatalogue();
	const auto found = std::ranges::lower_bound(catalogue, i_Tag, {}, &VItemDescriptor::m_Tag);
	return found != catalogue.end() && found->m_Tag == i_Tag ? &*found : nullptr;
}

const VItemDescriptor* FindItemType(std::string_view i_Name)
{
	const std::span<const VItemDescriptor> catalogue = ItemCatalogue();
	const auto found = std::ranges::find(catalogue, i_Name, &VItemDescriptor::m_Name);
	return found != catalogue.end() ? &*found : nullptr;
}

} // namespace Flow2TypesUtils
