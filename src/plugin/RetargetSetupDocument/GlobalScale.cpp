#include "RetargetSetupDocument/GlobalScale.h"

#include <cmath>

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
	std::string names;
	for (const VSubjectParametrised::VDynamicParameter& rParameter : i_rSubject.m_DynamicParameters)
		if (&rParameter != pScale)
			names += (names.empty() ? "" : "', '") + rParameter.m_Name;
	return names;
}

} // namespace RetargetSetup
