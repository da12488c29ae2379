#include "CoreOrlexQRTIO/format/EnumTables.h"
#include "CoreOrlexQRTIO/format/FormatFunctions.h"
#include "CoreOrlexQRTIO/format/FormatTable.h"
#include "CoreOrlexQRTIO/read/AttributeReading.h"

namespace CoreOrlexQRTIO
{
namespace
{

using CoreOrlexTypes::VSubjectParametrised;
using UtilsRapidXml::INode;
using UtilsRapidXml::ReadAttribute;

void FormatStaticParameter(INode& io_rNode, VReading& io_rReading)
{
	namespace Table = Format::StaticParameter;
	const std::size_t errors = io_rNode.GetErrorCount();
	VSubjectParametrised::VStaticParameter parameter;
	ReadAttribute(io_rNode, Table::c_Name, parameter.m_Name);
	ReadAttribute(io_rNode, Table::c_Value, parameter.m_UserValue);
	ReadAttribute(io_rNode, Table::c_Prior, parameter.m_Prior);
	ReadAttribute(io_rNode, Table::c_Expression, parameter.m_DefaultExpression);
	ReadHidden(io_rNode, Table::c_Hidden, parameter.m_Visible);
	ReadAttribute(io_rNode, Table::c_Advanced, parameter.m_Advanced);
	ReadAttribute(io_rNode, Table::c_ReadOnly, parameter.m_ReadOnly);
	ReadAttribute(io_rNode, Table::c_Required, parameter.m_Required);
	ReadAttribute(io_rNode, Table::c_Quantity, EnumTables::Quantity(), parameter.m_Quantity);
	if (io_rNode.GetErrorCount() == errors)
		io_rReading.m_rSubject.m_StaticParameters.push_back(std::move(parameter));
}

void FormatParameter(INode& io_rNode, VReading& io_rReading)
{
	namespace Table = Format::Parameter;
	const std::size_t errors = io_rNode.GetErrorCount();
	VSubjectParametrised::VDynamicParameter parameter;
	ReadAttribute(io_rNode, Table::c_Name, parameter.m_Name);
	ReadAttribute(io_rNode, Table::c_Value, parameter.m_Value);
	ReadAttribute(io_rNode, Table::c_Prior, parameter.m_Prior);
	ReadAttribute(io_rNode, Table::c_StandardDeviation, parameter.m_StandardDeviation);
	ReadHidden(io_rNode, Table::c_Hidden, parameter.m_Visible);
	if (io_rNode.GetErrorCount() == errors)
		io_rReading.m_rSubject.m_DynamicParameters.push_back(std::move(parameter));
}

} // namespace

void FormatParameters(INode& io_rNode, VReading& io_rReading)
{
	Process(io_rNode, Format::Parameters::c_StaticParameter,
	    [&](INode& io_rParameter) { FormatStaticParameter(io_rParameter, io_rReading); });
	Process(io_rNode, Format::Parameters::c_Parameter,
	    [&](INode& io_rParameter) { FormatParameter(io_rParameter, io_rReading); });
}

} // namespace CoreOrlexQRTIO
