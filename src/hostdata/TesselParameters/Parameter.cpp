#include "TesselParameters/Parameter.h"

#include "TesselParameters/Attributes.h"
#include "TesselParameters/Enumeration.h"

#include "DebugServices/GlobalLog.h"
#include "TesselDataStore/DataStore.h"
#include "TesselDataStore/DataWriter.h"
#include "TesselDataStore/TypedGet.h"

#include <algorithm>

namespace TesselParameters
{

using NVX::IO::VSchemaPointer;
using NVX::IO::VVariant;
using TesselDataStore::VDataReader;
using TesselDataStore::VDataVerifyReader;
using TesselDataStore::VDataVerifyWriter;
using TesselDataStore::VDataWriter;
using namespace TesselPluginInterface;

VParameter::VParameter(std::shared_ptr<IDataStore> i_pStore, const std::string& i_rPath, std::string i_Name,
    std::shared_ptr<const VParameterChecker> i_pChecker)
    : m_Name(std::move(i_Name)), m_StoreKey(i_rPath + "/" + m_Name),
      m_pStore(i_pStore ? std::move(i_pStore) : std::make_shared<TesselDataStore::VDataStore>()),
      m_pAttributes(std::make_shared<TesselDataStore::VDataStore>()), m_pChecker(std::move(i_pChecker))
{
}

VParameter::~VParameter() = default;

// Value

bool VParameter::HasValue() const
{
	const VVariant value = GetValue();
	std::string text;
	return !value.IsEmpty() && !(TesselDataStore::FromVariant(value, text) && text.empty());
}

VVariant VParameter::GetValue() const
{
	{
		const VDataVerifyReader reader(m_pStore);
		VVariant value;
		if (reader.Get(m_StoreKey, GetSchema(), value))
			return value;
		if (reader.HasValue(m_StoreKey))
			TesselDataStore::TellOtherType(m_StoreKey);
	}
	return GetDefault();
}

bool VParameter::SetValue(const VVariant& i_rValue)
{
	return SameSchema(i_rValue.m_pSchema, GetSchema()) && VDataVerifyWriter(m_pStore).Set(m_StoreKey, i_rValue);
}

void VParameter::ClearValue()
{
	VDataWriter(m_pStore).Remove(m_StoreKey);
}

void VParameter::ResetToDefault()
{
	const VVariant value = GetDefault();
	if (value.IsEmpty())
		ClearValue();
	else
		VDataWriter(m_pStore).Set(m_StoreKey, value);
}

std::string VParameter::GetValueText() const
{
	return ToText(GetValue());
}

std::string VParameter::SetValueText(const std::string& i_rText)
{
	VVariant value;
	std::string message;
	const std::vector<VEnumEntry> entries = GetEnumeration();
	const auto named = std::find_if(
	    entries.begin(), entries.end(), [&i_rText](const VEnumEntry& i_rEntry) { return i_rEntry.m_Name == i_rText; });
	if (named != entries.end())
		value = named->m_Value;
	else if (!m_pChecker->Accept(i_rText, VDataReader(m_pAttributes), value, message))
		return message;
	return SetValue(value) ? std::string() : "The stored value is of another type";
}

void VParameter::SetVerifyRequired(bool i_bRequired)
{
	if (HasDefault())
		NVX_LOG("VParameter", NVX::ELogWarning,
		    "VParameter::SetVerifyRequired called after VParameter::SetValueDefault for Parameter \"%1%\", parameters "
		    "previously imported from other Orlex applications may be lost.",
		    m_Name);
	m_bVerifyRequired = i_bRequired;
}

bool VParameter::HasDefault() const
{
	return !GetDefault().IsEmpty();
}

VVariant VParameter::GetDefault() const
{
	return AttributeValue(AttributeKeys::c_Default);
}

bool VParameter::SetValueDefault(const VVariant& i_rValue)
{
	if (!SetAttributeValue(AttributeKeys::c_Default, i_rValue))
		return false;
	if (!m_bVerifyRequired)
	{
		VDataWriter writer(m_pStore);
		if (writer.HasEntry(m_StoreKey) && !SameSchema(writer.GetSchema(m_StoreKey), GetSchema()))
			writer.Remove(m_StoreKey);
	}
	return true;
}

// Attributes

template <typename T>
T VParameter::Attribute(const char* i_pKey) const
{
	T value{};
	(void)TesselDataStore::TypedGet(VDataReader(m_pAttributes), i_pKey, value);
	return value;
}

template <typename T>
void VParameter::SetAttribute(const char* i_pKey, const T& i_rValue)
{
	VDataWriter(m_pAttributes).Set(i_pKey, TesselDataStore::ToVariant(i_rValue));
}

VVariant VParameter::AttributeValue(const char* i_pKey) const
{
	VVariant value;
	(void)VDataVerifyReader(m_pAttributes).Get(i_pKey, GetSchema(), value);
	return value;
}

bool VParameter::SetAttributeValue(const char* i_pKey, const VVariant& i_rValue)
{
	return SameSchema(i_rValue.m_pSchema, GetSchema()) && VDataWriter(m_pAttributes).Set(i_pKey, i_rValue);
}

std::string VParameter::GetCategory() const
{
	return Attribute<std::string>(AttributeKeys::c_Category);
}

void VParameter::SetCategory(const std::string& i_rText)
{
	SetAttribute(AttributeKeys::c_Category, i_rText);
}

std::string VParameter::GetDisplay() const
{
	return Attribute<std::string>(AttributeKeys::c_Display);
}

void VParameter::SetDisplay(const std::string& i_rText)
{
	SetAttribute(AttributeKeys::c_Display, i_rText);
}

std::string VParameter::GetDescription() const
{
	return Attribute<std::string>(AttributeKeys::c_Description);
}

void VParameter::SetDescription(const std::string& i_rText)
{
	SetAttribute(AttributeKeys::c_Description, i_rText);
}

EPresentationHint VParameter::GetPresentationHint() const
{
	return Attribute<EPresentationHint>(AttributeKeys::c_PresentationHint);
}

void VParameter::SetPresentationHint(EPresentationHint i_Hint)
{
	SetAttribute(AttributeKeys::c_PresentationHint, i_Hint);
}

EDataConversionHint VParameter::GetDataConversionHint() const
{
	return Attribute<EDataConversionHint>(AttributeKeys::c_DataConversionHint);
}

void VParameter::SetDataConversionHint(EDataConversionHint i_Hint)
{
	SetAttribute(AttributeKeys::c_DataConversionHint, i_Hint);
}

EFileAccess VParameter::GetFileAccess() const
{
	return Attribute<EFileAccess>(AttributeKeys::c_FileAccess);
}

void VParameter::SetFileAccess(EFileAccess i_Access)
{
	SetAttribute(AttributeKeys::c_FileAccess, i_Access);
}

std::string VParameter::GetFileFilter() const
{
	return Attribute<std::string>(AttributeKeys::c_FileFilter);
}

void VParameter::SetFileFilter(const std::string& i_rText)
{
	SetAttribute(AttributeKeys::c_FileFilter, i_rText);
}

std::string VParameter::GetValidatorRegEx() const
{
	return Attribute<std::string>(AttributeKeys::c_ValidatorRegEx);
}

void VParameter::SetValidatorRegEx(const std::string& i_rText)
{
	SetAttribute(AttributeKeys::c_ValidatorRegEx, i_rText);
}

namespace
{

constexpr std::pair<IParameter::EFlags, const char*> c_FlagKeys[] = {{IParameter::EHidden, AttributeKeys::c_Hidden},
    {IParameter::EAdvanced, AttributeKeys::c_Advanced}, {IParameter::EDynamic, AttributeKeys::c_Dynamic}};

} // namespace

std::uint32_t VParameter::GetFlags() const
{
	const VDataReader reader(m_pAttributes);
	std::uint32_t flags = 0;
	for (const auto& [flag, pKey] : c_FlagKeys)
	{
		bool bSet = false;
		(void)reader.GetBool(pKey, bSet);
		if (bSet)
			flags |= flag;
	}
	return flags;
}

void VParameter::SetFlags(std::uint32_t i_Flags)
{
	VDataWriter writer(m_pAttributes);
	for (const auto& [flag, pKey] : c_FlagKeys)
		writer.SetBool(pKey, (i_Flags & flag) != 0);
}

// Limits and permitted values

VVariant VParameter::GetMinimum() const
{
	return AttributeValue(AttributeKeys::c_Min);
}

bool VParameter::SetMinimum(const VVariant& i_rValue)
{
	return SetAttributeValue(AttributeKeys::c_Min, i_rValue);
}

VVariant VParameter::GetMaximum() const
{
	return AttributeValue(AttributeKeys::c_Max);
}

bool VParameter::SetMaximum(const VVariant& i_rValue)
{
	return SetAttributeValue(AttributeKeys::c_Max, i_rValue);
}

bool VParameter::HasEnumeration() const
{
	return VDataReader(m_pAttributes).HasValue(AttributeKeys::c_Enum);
}

std::vector<VEnumEntry> VParameter::GetEnumeration() const
{
	return ReadEnumeration(VDataReader(m_pAttributes), GetSchema());
}

bool VParameter::SetEnumeration(const std::vector<VEnumEntry>& i_rEntries)
{
	VVariant list;
	return EnumerationToVariant(i_rEntries, GetSchema(), list)
	    && VDataWriter(m_pAttributes).Set(AttributeKeys::c_Enum, list);
}

// Changes

NVX::VConnection VParameter::ConnectValue(std::function<void()> i_Callback, std::shared_ptr<IDispatcher> i_pDispatcher)
{
	return m_pStore->Subscribe(
	    m_StoreKey, [callback = std::move(i_Callback)](const std::string&) { callback(); }, std::move(i_pDispatcher));
}

NVX::VConnection VParameter::ConnectAttributes(
    std::function<void()> i_Callback, std::shared_ptr<IDispatcher> i_pDispatcher)
{
	return m_pAttributes->Subscribe(
	    "Attributes/", [callback = std::move(i_Callback)](const std::string&) { callback(); },
	    std::move(i_pDispatcher));
}

} // namespace TesselParameters
