#pragma once

#include <pybind11/pybind11.h>

namespace CommandLine::Python
{

/// The class Session: a performer's skeleton, a character's, and the targets between them, as the commands "create" and
/// "edit" work on them.
void DefineSession(pybind11::module_& io_rModule);

} // namespace CommandLine::Python
