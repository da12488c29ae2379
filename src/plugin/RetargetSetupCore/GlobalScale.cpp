#include "RetargetSetupCore/GlobalScale.h"

#include "CoreOrlexTypesUtils/observations/UnusedParameters.h"

#include <cmath>
#include <set>

using CoreOrlexTypes::VSubjectParametrised;

namespace RetargetSetup
{

namespace
{

const VSubjectParametrised::VDynamicParameter* FindScale(const VSubjectParametrised& i_rSubject)
{
	for (const VSubjectParametrised::VDynamicParameter& rParameter : i_rSubject.m_DynamicParameters)
		if (rParameter.m_Name == c_GlobalScaleName)
			return &rParameter;
	return nullptr;
}

template <typename TCounts>
std::string JoinedNames(const VSubjectParametrised& i_rSubject, const TCounts& i_rCounts)
{
	std::string names;
	for (const VSubjectParametrised::VDynamicParameter& rParameter : i_rSubject.m_DynamicParameters)
		if (i_rCounts(rParameter))
			names += (names.empty() ? "" : "', '") + rParameter.m_Name;
	return names;
}

} // namespace

bool IsUsableScale(double i_Scale)
{
	return std::isfinite(i_Scale) && i_Scale > 0.0;
}

void SetGlobalScale(VSubjectParametrised& io_rSubject, double i_Scale)
{
	io_rSubject.m_DynamicParameters.resize(1);
	VSubjectParametrised::VDynamicParameter& rParameter = io_rSubject.m_DynamicParameters.front();
	rParameter.m_Name = c_GlobalScaleName;
	rParameter.m_Prior = i_Scale;
	rParameter.m_Value = i_Scale;
}

double GetGlobalScale(const VSubjectParametrised& i_rSubject)
{
	const VSubjectParametrised::VDynamicParameter* const pScale = FindScale(i_rSubject);
	return pScale ? pScale->m_Value : 1.0;
}

std::string DroppedParameters(const VSubjectParametrised& i_rSubject)
{
	const VSubjectParametrised::VDynamicParameter* const pScale = FindScale(i_rSubject);
	return JoinedNames(i_rSubject, [pScale](const auto& i_rParameter) { return &i_rParameter != pScale; });
}

std::string LostParameters(const VSubjectParametrised& i_rSubject)
{
	const std::set<std::string> used = CoreOrlexTypesUtils::ParametersInUse(i_rSubject);
	return JoinedNames(i_rSubject,
	    [&used](const auto& i_rParameter)
	    { return i_rParameter.m_Name != c_GlobalScaleName && used.count(i_rParameter.m_Name) > 0; });
}

} // namespace RetargetSetup
