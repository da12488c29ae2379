#pragma once

#include "CoreOrlexTypes/SubjectRecord.h"
#include "CoreOrlexTypesUtils/SubjectKinematics.h"

#include <string>

namespace CommandLine
{

/// Forward kinematics of a subject as it stands in a file; targets that have none are told and left out. Throws
/// VCommandError with EBadInput if the segments make no tree.
/// @param i_rFile what the subject is called where that is told.
CoreOrlexTypesUtils::VSubjectKinematics KinematicsOf(
    const std::string& i_rFile, const CoreOrlexTypes::VSubjectRecord& i_rRecord);

} // namespace CommandLine
