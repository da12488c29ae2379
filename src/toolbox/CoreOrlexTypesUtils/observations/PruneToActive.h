#pragma once

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectApplicationData.h"

namespace CoreOrlexTypesUtils::SubjectParametrisedUtils
{

/// Keeps only the given markers and rotation observations, in their old order. Targets lose those that are not given
/// and go when none is left; a rigid body goes on with its other markers as long as it has three. Targets, sticks and
/// the application data follow. The given ones are expected to be fewer than all of a subject that has any, and indices
/// beyond the lists mean nothing.
/// For both subject types, TSubject. False, with nothing changed, for a subject without segments (told, category
/// "SubjectUtils" or "SubjectParametrisedUtils").
template <typename TSubject>
bool PruneToActive(TSubject& io_rSubject, CoreOrlexTypes::VSubjectApplicationData& io_rAppData,
    const std::vector<std::uint32_t>& i_rActiveMarkers, const std::vector<std::uint32_t>& i_rActiveRotations);

/// The same of a subject without application data.
template <typename TSubject>
bool PruneToActive(TSubject& io_rSubject, const std::vector<std::uint32_t>& i_rActiveMarkers,
    const std::vector<std::uint32_t>& i_rActiveRotations);

} // namespace CoreOrlexTypesUtils::SubjectParametrisedUtils
