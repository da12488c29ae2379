#pragma once

#include <array>
#include <cstddef>

namespace SetupProposal
{

/// What a segment is of a body that stands on two legs. EOther is what has no peer: helpers, controls, props, clothes.
enum EBodyPart : std::size_t
{
	ERoot,
	EPelvis,
	ESpine,
	ENeck,
	EHead,
	EClavicle,
	EUpperArm,
	EForeArm,
	EHand,
	EThumb,
	EIndexFinger,
	EMiddleFinger,
	ERingFinger,
	ELittleFinger,
	EThigh,
	EShin,
	EFoot,
	EToe,
	EOther
};

inline constexpr std::size_t c_BodyParts = EOther + 1;

/// One number for each part.
using VPartScores = std::array<double, c_BodyParts>;

/// In words for the operator.
constexpr const char* NameOf(EBodyPart i_Part)
{
	constexpr std::array<const char*, c_BodyParts> c_Names{"root", "pelvis", "spine", "neck", "head", "clavicle",
	    "upper arm", "forearm", "hand", "thumb", "index finger", "middle finger", "ring finger", "little finger",
	    "thigh", "shin", "foot", "toe", "helper"};
	return c_Names[i_Part];
}

/// Whether a body has one on each side.
constexpr bool HasSides(EBodyPart i_Part)
{
	return i_Part >= EClavicle && i_Part <= EToe;
}

constexpr bool IsFinger(EBodyPart i_Part)
{
	return i_Part >= EThumb && i_Part <= ELittleFinger;
}

} // namespace SetupProposal
