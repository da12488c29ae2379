#pragma once

#include "CoreOrlexTypes/SubjectParametrised.h"

#include <array>
#include <cstdint>
#include <string>

namespace RetargetSetup
{

/// What the panel shows of a target: numbers where the file holds expressions.
struct VShownTarget
{
	/// -1 for none.
	std::int32_t m_Index = -1;
	double m_Weight = 0.0;
	/// In mm or radians; an expression that cannot be evaluated shows as 0.
	std::array<std::string, 3> m_State{};
	/// The state of a rotation target is no thing to type: its three numbers only make sense together.
	bool m_bStateHidden = false;
};

/// Nothing of a target that is not there but the index -1.
VShownTarget ShowTarget(const CoreOrlexTypes::VSubjectParametrised& i_rSubject, std::int32_t i_TargetIndex);

/// Applies to the target that is shown what the operator has changed of it, and leaves the rest as the file has it.
/// @param i_rShown what was last shown.
/// @param i_rEdited what stands in the panel now.
/// @return false if nothing differs, or if the target is not there.
bool ApplyEdits(
    CoreOrlexTypes::VSubjectParametrised& io_rSubject, const VShownTarget& i_rShown, const VShownTarget& i_rEdited);

} // namespace RetargetSetup
