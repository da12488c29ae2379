#include "CoreOrlexQRTIO/format/FormatFunctions.h"
#include "CoreOrlexQRTIO/format/FormatTable.h"
#include "CoreOrlexQRTIO/read/AttributeReading.h"
#include "CoreOrlexTypes/JointType.h"

#include <boost/format.hpp>

#include <algorithm>

namespace CoreOrlexQRTIO
{
namespace
{

using UtilsRapidXml::INode;
using UtilsRapidXml::ReadAttribute;
using VSegment = CoreOrlexTypes::VSubjectParametrised::VSegment;

void FormatPrincipalComponent(
    INode& io_rNode, std::size_t i_ParameterCount, VSubjectQRTExtras::VDynamicSubspace& io_rSubspace)
{
	namespace Table = Format::PrincipalComponent;
	const std::size_t errors = io_rNode.GetErrorCount();
	VSubjectQRTExtras::VPrincipalComponent component;
	ReadAttribute(io_rNode, Table::c_Name, component.m_Name);
	UtilsRapidXml::ReadList(io_rNode, Table::c_JointParams, i_ParameterCount, component.m_JointParams);
	ReadAttribute(io_rNode, Table::c_SqrtEigenvalue, component.m_SqrtEigenvalue);
	ReadAttribute(io_rNode, Table::c_LowerBound, component.m_LowerBound);
	ReadAttribute(io_rNode, Table::c_UpperBound, component.m_UpperBound);
	ReadAttribute(io_rNode, Table::c_TemporalDerivativeSd, component.m_TemporalDerivativeSd);
	const auto refuse = [&](const char* i_pFormat)
	{ io_rNode.AddError((boost::format(i_pFormat) % io_rSubspace.m_Name % component.m_Name).str()); };
	if (component.m_SqrtEigenvalue < 0.0)
		refuse(" Non-negative 'SQRT-EIGENVALUE' at '%s : %s' ");
	if (component.m_LowerBound > component.m_UpperBound)
		refuse(" 'LOWER-EIGENVALUE' greater than 'UPPER-BOUND' at '%s : %s' ");
	if (component.m_TemporalDerivativeSd < 0.0)
		refuse("'TEMPORAL-DERIVATIVE-SD' is negative at '%s %s'");
	if (io_rNode.GetErrorCount() == errors)
		io_rSubspace.m_Components.push_back(std::move(component));
}

void FormatPcaControlledParams(INode& io_rNode, VReading& io_rReading)
{
	namespace Table = Format::Subspace;
	const std::size_t errors = io_rNode.GetErrorCount();
	VSubjectQRTExtras::VDynamicSubspace subspace;
	ReadAttribute(io_rNode, Table::c_Name, subspace.m_Name);
	ReadAttribute(io_rNode, Table::c_Version, subspace.m_Version);
	std::string names;
	ReadAttribute(io_rNode, Table::c_JointNames, names);
	std::size_t parameterCount = 0;
	for (std::string_view name : UtilsRapidXml::SplitBlanks(names))
	{
		const auto it = io_rReading.m_JointsByName.find(subspace.m_JointNames.emplace_back(name));
		if (it == io_rReading.m_JointsByName.end())
			io_rNode.AddError((boost::format("Undefined joint '%s'") % name).str());
		else
			parameterCount +=
			    CoreOrlexTypes::StateSize(io_rReading.m_rSubject.m_Segments[it->second].m_Joint.m_JointType);
	}
	UtilsRapidXml::ReadList(io_rNode, Table::c_JointParamsMean, parameterCount, subspace.m_JointParamsMean);
	Process(io_rNode, Table::c_PrincipalComponent,
	    [&](INode& io_rComponent) { FormatPrincipalComponent(io_rComponent, parameterCount, subspace); });
	if (io_rNode.GetErrorCount() == errors)
		io_rReading.m_rExtras.m_DynamicSubspaces.push_back(std::move(subspace));
}

} // namespace

void FormatSubjectDynamicSubspace(INode& io_rNode, VReading& io_rReading)
{
	io_rReading.m_rExtras.m_DynamicSubspaces.clear();
	for (const VSegment& rSegment : io_rReading.m_rSubject.m_Segments)
		io_rReading.m_JointsByName.emplace(rSegment.m_Joint.m_Name, rSegment.m_SegmentIndex);
	Process(io_rNode, Format::Subspace::c_PcaControlledParams,
	    [&](INode& io_rSubspace) { FormatPcaControlledParams(io_rSubspace, io_rReading); });
	// A subject whose joints cannot move has no states that could vary together.
	if (std::ranges::none_of(io_rReading.m_rSubject.m_Segments,
	        [](const VSegment& i_rSegment) { return CoreOrlexTypes::StateSize(i_rSegment.m_Joint.m_JointType) > 0; }))
		io_rNode.AddError("'SubjectDynamicSubspace' is not compatible with subject");
	if (io_rReading.m_rExtras.m_DynamicSubspaces.empty())
		io_rNode.AddError(
		    "'SubjectDynamicSubspace' declared but does not contain any valid 'PcaControlledParams' elements");
}

} // namespace CoreOrlexQRTIO
