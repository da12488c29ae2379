#include "TesselParameters/Attributes.h"

#include "TesselDataStore/StoredValueOfFields.h"
#include "TesselPluginInterface/IParameter.h"

namespace CoreOrlexTypes
{

using TesselPluginInterface::EDataConversionHint;
using TesselPluginInterface::EFileAccess;
using TesselPluginInterface::EPresentationHint;

template <>
inline constexpr auto c_Enumeration<EPresentationHint> = VEnumeration<EPresentationHint, 6>(
    "Parameter.PresentationHint.Enum", "How a control shows the parameter.",
    {{EPresentationHint::EDontCare, "DontCare"}, {EPresentationHint::ESlider, "Slider"},
        {EPresentationHint::EMultiLine, "MultiLine"}, {EPresentationHint::ECheckableOption, "CheckableOption"},
        {EPresentationHint::ECheckableSlider, "CheckableSlider"}, {EPresentationHint::EColour, "Colour"}});

template <>
inline constexpr auto c_Enumeration<EDataConversionHint> = VEnumeration<EDataConversionHint, 3>(
    "Parameter.DataConversionHint.Enum", "The unit in which a control shows the parameter.",
    {{EDataConversionHint::ENoConversion, "NoConversion"}, {EDataConversionHint::ESecondsToTick135, "SecondsToTick135"},
        {EDataConversionHint::EMillisecondsToTick135, "MillisecondsToTick135"}});

template <>
inline constexpr auto c_Enumeration<EFileAccess> = VEnumeration<EFileAccess, 5>("Parameter.FileAccess.Enum",
    "What a control's file dialog is for.",
    {{EFileAccess::ENone, "None"}, {EFileAccess::EFolder, "Folder"}, {EFileAccess::ESave, "Save"},
        {EFileAccess::ELoad, "Load"}, {EFileAccess::ELoadMultiple, "LoadMultiple"}});

} // namespace CoreOrlexTypes

RETARGET_STORED_VALUE(TesselPluginInterface::EPresentationHint)
RETARGET_STORED_VALUE(TesselPluginInterface::EDataConversionHint)
RETARGET_STORED_VALUE(TesselPluginInterface::EFileAccess)

namespace TesselParameters
{

using TesselDataStore::SchemaOf;

NVX::IO::VSchemaPointer EnumerationSchema(const NVX::IO::VSchemaPointer& i_rpValue)
{
	NVX::IO::ISchema entry;
	entry.m_Type = NVX::IO::EType::ENamedTuple;
	entry.m_Children = {{"Name", "What the user chooses by.", 0, SchemaOf<std::string>()}, {"Value", "", 0, i_rpValue}};
	return NVX::IO::ListSchema(GetUniqueSchema(entry));
}

NVX::IO::VSchemaPointer AttributesSchema(const NVX::IO::VSchemaPointer& i_rpValue)
{
	const NVX::IO::VSchemaPointer& rpText = SchemaOf<std::string>();
	const NVX::IO::VSchemaPointer& rpFlag = SchemaOf<bool>();
	const std::pair<const char*, NVX::IO::VSchemaPointer> members[] = {
	    {AttributeKeys::c_Category, rpText},
	    {AttributeKeys::c_Display, rpText},
	    {AttributeKeys::c_Description, rpText},
	    {AttributeKeys::c_PresentationHint, SchemaOf<TesselPluginInterface::EPresentationHint>()},
	    {AttributeKeys::c_DataConversionHint, SchemaOf<TesselPluginInterface::EDataConversionHint>()},
	    {AttributeKeys::c_FileAccess, SchemaOf<TesselPluginInterface::EFileAccess>()},
	    {AttributeKeys::c_FileFilter, rpText},
	    {AttributeKeys::c_ValidatorRegEx, rpText},
	    {AttributeKeys::c_Hidden, rpFlag},
	    {AttributeKeys::c_Advanced, rpFlag},
	    {AttributeKeys::c_Dynamic, rpFlag},
	    {AttributeKeys::c_Default, i_rpValue},
	    {AttributeKeys::c_Min, i_rpValue},
	    {AttributeKeys::c_Max, i_rpValue},
	    {AttributeKeys::c_Enum, EnumerationSchema(i_rpValue)},
	};
	NVX::IO::ISchema schema;
	schema.m_Type = NVX::IO::EType::ENamedTuple;
	schema.m_Name = "Attributes";
	for (const auto& [pKey, rpSchema] : members)
		schema.m_Children.push_back({std::string(pKey).substr(std::string("Attributes/").size()), "", 0, rpSchema});
	return GetUniqueSchema(schema);
}

} // namespace TesselParameters
