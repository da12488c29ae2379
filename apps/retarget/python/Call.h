#pragma once

#include <functional>

namespace CommandLine::Python
{

/// Does work of the libraries on behalf of Python: without the interpreter lock, so that other threads of Python go on.
/// What the libraries tell goes to the logger "retarget_setup.CATEGORY" of Python's logging when the work is done, what
/// they tell on other threads with the next call. Work that throws VCommandError, or tells an error, ends in the
/// package's exception Error with that text. What throws otherwise comes to Python as pybind11 has it.
/// @param i_rWork touches nothing of Python.
/// @param i_bForgive errors that are told are no failure: the work throws if it has failed.
void Call(const std::function<void()>& i_rWork, bool i_bForgive = false);

/// The exception that Call raises, made by the package: takes the text and the exit status.
void RegisterError(const void* i_pType);

/// Sends the log to Python for as long as the interpreter lives.
void BeginListening();
void EndListening();

} // namespace CommandLine::Python
