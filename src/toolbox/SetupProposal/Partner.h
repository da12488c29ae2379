#pragma once

#include "SetupProposal/RestSkeleton.h"

#include <cstddef>
#include <cstdint>

namespace SetupProposal
{

enum class EPartnerRule
{
	None,
	/// The names differ in nothing but the side that a word of them tells.
	Names,
	/// One stands where the mirror image of the other does.
	Places
};

struct VPartner
{
	/// -1 for none.
	std::int64_t m_Joint = -1;
	EPartnerRule m_Rule = EPartnerRule::None;
};

/// The joint on the other side of the body. Names come first; a joint whose name tells another side than the one that
/// is looked for is no partner by its place.
VPartner FindPartner(const VRestSkeleton& i_rSkeleton, std::size_t i_Joint);

} // namespace SetupProposal
