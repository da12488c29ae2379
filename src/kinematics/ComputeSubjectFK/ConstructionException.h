#pragma once

#include <exception>

namespace ComputeSubject
{

/// A joint or a target that does not fit the class that its type names.
class VConstructionException : public std::exception
{
};

} // namespace ComputeSubject
