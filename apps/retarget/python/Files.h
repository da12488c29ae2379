#pragma once

#include "retarget/subject/SubjectFile.h"

#include <pybind11/pybind11.h>

#include <string>

namespace CommandLine::Python
{

/// A path as the command line's words have it, where "-" is a standard stream and here a file of that name.
std::string FilePath(const std::string& i_rPath);

/// What a file holds as (subject, application data, extras); the last one is only handed on.
pybind11::tuple ToPython(VSubjectFile i_File);
/// Throws TypeError or ValueError for what is none, ValueError also where the application data does not run parallel.
VSubjectFile FileFrom(const pybind11::tuple& i_rParts);

/// Reading, writing, checking and comparing files of the skeleton family, the bones of FBX files, and kinematics.
void DefineFiles(pybind11::module_& io_rModule);
void DefineKinematics(pybind11::module_& io_rModule);

} // namespace CommandLine::Python
