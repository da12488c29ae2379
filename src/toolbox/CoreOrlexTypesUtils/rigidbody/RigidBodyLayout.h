#pragma once

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectApplicationData.h"

/// The two layouts of a rigid body (see RigidBody.h).
namespace CoreOrlexTypesUtils::RigidBodyUtils
{

/// Whether a subject is a rigid body in either layout; the first fault is told as an error.
template <typename TSubject>
bool ValidateRigidBody(const TSubject& i_rSubject);

/// Makes one ERigidBody target, with the identity as its pose, of several point targets. Positions stay as they are
/// written, expressions too. The application data's targets follow. A subject of that layout already is left alone.
template <typename TSubject>
bool ToRigidBodyTarget(TSubject& io_rSubject, CoreOrlexTypes::VSubjectApplicationData& io_rAppData);
template <typename TSubject>
bool ToRigidBodyTarget(TSubject& io_rSubject);

/// Makes a Gaussian point target on the root of each marker of the ERigidBody target, named after the marker. Where the
/// body's pose is not the identity positions become numbers; static parameters that only the body used go.
template <typename TSubject>
bool ToPointTargets(TSubject& io_rSubject, CoreOrlexTypes::VSubjectApplicationData& io_rAppData);
template <typename TSubject>
bool ToPointTargets(TSubject& io_rSubject);

} // namespace CoreOrlexTypesUtils::RigidBodyUtils
