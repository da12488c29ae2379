#pragma once

#include "CoreOrlexTypes/SubjectApplicationData.h"
#include "CoreOrlexTypes/SubjectParametrised.h"
#include "CoreOrlexTypesUtils/observations/Renumbering.h"

namespace CoreOrlexTypesUtils
{

/// A renumbering that drops the markers, or rotation observations, that no target names; the others keep their order.
/// For both subject types, TSubject.
template <typename TSubject>
VRenumbering NamedMarkers(const TSubject& i_rSubject);
template <typename TSubject>
VRenumbering NamedRotations(const TSubject& i_rSubject);

/// Drops the markers that no target names. The others keep their order, and targets, sticks and the application data's
/// markers follow; a stick that names a dropped marker goes. An index beyond the list is left as it is and stays
/// beyond.
void RemoveUnusedMarkers(
    CoreOrlexTypes::VSubjectParametrised& io_rSubject, CoreOrlexTypes::VSubjectApplicationData& io_rApplicationData);

/// Drops the rotation observations that no target names; the others keep their order and targets follow.
void RemoveUnusedRotations(CoreOrlexTypes::VSubjectParametrised& io_rSubject);

} // namespace CoreOrlexTypesUtils
