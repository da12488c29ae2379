#include "UtilsRapidXml/Version.h"

std::string UtilsRapidXml::ToText(VVersion i_Version)
{
	return std::to_string(i_Version.m_Major) + '.' + std::to_string(i_Version.m_Minor);
}
