#pragma once

#include "CoreOrlexTypesUtils/convert/StaticExpressionParser.h"
#include "SetupReview/compare/Comparison.h"

namespace SetupReview
{

/// Two set-ups with their expressions; the second's are evaluated with the dynamic parameters of the first.
class VExpressions
{
public:
	VExpressions(const VSetup& i_rBefore, const VSetup& i_rAfter);

	const VSetup& m_rBefore;
	const VSetup& m_rAfter;
	CoreOrlexTypesUtils::VDynamicExpressionParserSimple m_Before;
	CoreOrlexTypesUtils::VDynamicExpressionParserSimple m_After;
};

/// Gives the change of a field the words that its trade has, and what is measured of it.
/// @param io_rChange with all but them, and the words that any field has.
/// @param i_Before, i_After indices of the element in its lists.
/// @return false for a change that another one tells: what a pruned joint loses, what follows the bind pose.
bool PutInWords(
    const VExpressions& i_rExpressions, std::size_t i_Before, std::size_t i_After, VSetupChange& io_rChange);

} // namespace SetupReview
