#pragma once

#include "CoreOrlexTypes/Subject.h"
#include "CoreOrlexTypes/SubjectApplicationData.h"

#include <cstddef>
#include <string>

/// Rigid bodies (see RigidBody.h) on the segments of other subjects. Everything is checked before anything changes.
namespace CoreOrlexTypesUtils::RigidBodyUtils
{

/// Merges a body, of either layout, into a subject: its parameters, its markers, whose ids become the hashes of their
/// names, its sticks, and one ERigidBody target on the segment of that name. With the joints of both in their Mean the
/// markers stay where they are in the world; the target's pose becomes numbers, its marker positions stay as written.
/// Static parameters that only the pose used are left behind.
template <typename TSubject>
bool AttachRigidBody(TSubject& io_rSubject, CoreOrlexTypes::VSubjectApplicationData& io_rSubjectAppData,
    const TSubject& i_rRigidBody, const CoreOrlexTypes::VSubjectApplicationData& i_rRigidBodyAppData,
    const std::string& i_rSegmentName);

/// Takes a body's target away, with its markers, the sticks between them, the static parameters that only it used, and
/// the segment if that is the body's own: a free "Root" with the joint "RootJoint" that no other target is on.
template <typename TSubject>
bool RemoveRigidBody(
    TSubject& io_rSubject, CoreOrlexTypes::VSubjectApplicationData& io_rSubjectAppData, std::size_t i_TargetIndex);

} // namespace CoreOrlexTypesUtils::RigidBodyUtils
