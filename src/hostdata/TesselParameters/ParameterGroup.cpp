#include "TesselParameters/ParameterGroup.h"

#include "TesselParameters/Attributes.h"

#include "TesselDataStore/DataStore.h"
#include "TesselDataStore/DataWriter.h"

#include <algorithm>

namespace TesselParameters
{

namespace
{

std::string Text(const std::shared_ptr<TesselPluginInterface::IDataStore>& i_rpAttributes, const char* i_pKey)
{
	std::string text;
	(void)TesselDataStore::VDataReader(i_rpAttributes).GetString(i_pKey, text);
	return text;
}

} // namespace

VParameterGroup::VParameterGroup(
    std::shared_ptr<TesselPluginInterface::IDataStore> i_pStore, std::string i_Path, std::string i_Name)
    : m_pStore(std::move(i_pStore)), m_Path(std::move(i_Path)), m_Name(std::move(i_Name)),
      m_pAttributes(std::make_shared<TesselDataStore::VDataStore>())
{
}

VParameterGroup::~VParameterGroup()
{
	m_EndingSignal.Fire();
}

void VParameterGroup::Add(std::shared_ptr<TesselPluginInterface::IParameter> i_pParameter)
{
	m_Parameters.push_back(std::move(i_pParameter));
	m_ChangedSignal.Fire();
}

void VParameterGroup::AddChild(std::shared_ptr<TesselPluginInterface::IParameterGroup> i_pGroup)
{
	m_Children.push_back(std::move(i_pGroup));
	m_ChangedSignal.Fire();
}

std::string VParameterGroup::GetDisplay() const
{
	const std::string text = Text(m_pAttributes, AttributeKeys::c_Display);
	return text.empty() ? m_Name : text;
}

void VParameterGroup::SetDisplay(const std::string& i_rText)
{
	TesselDataStore::VDataWriter(m_pAttributes).SetString(AttributeKeys::c_Display, i_rText);
}

std::string VParameterGroup::GetDescription() const
{
	return Text(m_pAttributes, AttributeKeys::c_Description);
}

void VParameterGroup::SetDescription(const std::string& i_rText)
{
	TesselDataStore::VDataWriter(m_pAttributes).SetString(AttributeKeys::c_Description, i_rText);
}

std::shared_ptr<TesselPluginInterface::IParameter> VParameterGroup::Find(const std::string& i_rName) const
{
	const auto found = std::find_if(m_Parameters.begin(), m_Parameters.end(),
	    [&i_rName](const auto& i_rpParameter) { return i_rpParameter->GetName() == i_rName; });
	return found == m_Parameters.end() ? nullptr : *found;
}

} // namespace TesselParameters
