#include "TesselPluginRetargetSetup/ShownTarget.h"

#include "CoreOrlexTypesUtils/convert/StaticExpressionParser.h"
#include "RetargetSetupCore/RetargetTargets.h"
#include "math/NumberText.h"

#include <bit>

using CoreOrlexTypes::VSubjectParametrised;

namespace RetargetSetup
{

VShownTarget ShowTarget(const VSubjectParametrised& i_rSubject, std::int32_t i_TargetIndex)
{
	VShownTarget shown;
	if (std::uint32_t(i_TargetIndex) >= i_rSubject.m_Targets.size())
		return shown;
	const VSubjectParametrised::VTarget& rTarget = i_rSubject.m_Targets[std::size_t(i_TargetIndex)];
	shown.m_Index = i_TargetIndex;
	shown.m_Weight = rTarget.m_Weight;
	shown.m_bStateHidden = rTarget.m_Type == VSubjectParametrised::VTarget::ELocalRotationToWorldRotation;

	CoreOrlexTypesUtils::VDynamicExpressionParserSimple parser;
	std::vector<std::string> errors;
	parser.Initialise(i_rSubject, errors);
	for (std::size_t i = 0; i < shown.m_State.size(); ++i)
	{
		double value = 0.0;
		std::string error;
		if (i < rTarget.m_StateExpressions.size() && !parser.Evaluate(rTarget.m_StateExpressions[i], value, error))
			value = 0.0;
		shown.m_State[i] = NumberText::PrintG17(value);
	}
	return shown;
}

bool ApplyEdits(VSubjectParametrised& io_rSubject, const VShownTarget& i_rShown, const VShownTarget& i_rEdited)
{
	if (std::uint32_t(i_rShown.m_Index) >= io_rSubject.m_Targets.size())
		return false;
	bool bChanged = false;
	if (std::bit_cast<std::uint64_t>(i_rShown.m_Weight) != std::bit_cast<std::uint64_t>(i_rEdited.m_Weight))
	{
		io_rSubject.m_Targets[std::size_t(i_rShown.m_Index)].m_Weight = i_rEdited.m_Weight;
		bChanged = true;
	}
	for (std::size_t i = 0; i < i_rShown.m_State.size(); ++i)
		if (i_rShown.m_State[i] != i_rEdited.m_State[i])
		{
			SetStateExpression(io_rSubject, i_rEdited.m_State[i], std::size_t(i_rShown.m_Index), i);
			bChanged = true;
		}
	return bChanged;
}

} // namespace RetargetSetup
