#include "Flow2TypesUtils/Parameter.h"

#include "Flow2TypesUtils/ParameterText.h"
#include "TesselPluginInterface/IParameter.h"

#include <utility>

using TesselPluginInterface::EFileAccess;

namespace Flow2Utils
{

namespace
{

const char* Text(EFileAccess i_Access)
{
	switch (i_Access)
	{
	case EFileAccess::EFolder: return "Folder";
	case EFileAccess::ESave: return "Save";
	case EFileAccess::ELoad: return "Load";
	case EFileAccess::ELoadMultiple: return "LoadMultiple";
	case EFileAccess::ENone: break;
	}
	return "";
}

} // namespace

VParameter::VParameter(std::string i_Name) : m_Name(std::move(i_Name)) {}
VParameter::VParameter(const VParameter&) = default;
VParameter::~VParameter() = default;

std::map<std::string, std::string> VParameter::GetAttributes() const
{
	std::map<std::string, std::string> attributes;
	const auto add = [&attributes](const char* i_pKey, const std::string& i_rText)
	{
		if (!i_rText.empty())
			attributes.emplace(i_pKey, i_rText);
	};
	add("<FriendlyName>", m_FriendlyName);
	add("<Description>", m_Description);
	add("<Category>", m_Category);
	add("<Advanced>", m_bAdvanced ? ToText(true) : "");
	add("<Hidden>", m_bHidden ? ToText(true) : "");
	add("<Serialized>", m_bSerialised ? "" : ToText(false));
	add("<FileAccess>", Text(m_FileAccess));
	add("<FileFilter>", m_FileFilter);
	return attributes;
}

void VParameter::NoteChange(bool i_bSet)
{
	m_bSet = i_bSet;
	++m_ChangeCounter;
}

} // namespace Flow2Utils
