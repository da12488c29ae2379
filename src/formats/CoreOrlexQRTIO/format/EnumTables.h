#pragma once

#include "CoreOrlexTypes/SubjectApplicationData.h"
#include "CoreOrlexTypes/SubjectParametrised.h"
#include "UtilsRapidXml/Enum.h"

#include <cstdint>

/// The named values of the skeleton format. Built at first use and only read afterwards.
namespace CoreOrlexQRTIO::EnumTables
{

/// Set in a TYPE_STATUS value when the marker is missing; the rest is the marker's status.
inline constexpr std::uint32_t c_StatusMissing = 1u << 27;

const UtilsRapidXml::VEnum<CoreOrlexTypes::VSubjectApplicationData::VSegment::EDrawShading>& DrawShading();
const UtilsRapidXml::VEnum<CoreOrlexTypes::VSubjectApplicationData::VSegment::EDrawStyle>& DrawStyle();
const UtilsRapidXml::VEnum<CoreOrlexTypes::VSubjectApplicationData::VJoint::EEulerOrder>& EulerOrder();
const UtilsRapidXml::VEnum<CoreOrlexTypes::VSubjectParametrised::VStaticParameter::EQuantity>& Quantity();
const UtilsRapidXml::VEnum<std::uint32_t>& Status();
const UtilsRapidXml::VEnum<CoreOrlexTypes::VSubjectApplicationData::VTarget::EDrawStyle>& TargetDrawStyle();

} // namespace CoreOrlexQRTIO::EnumTables
