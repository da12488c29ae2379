#pragma once

#include "TakeIO/Take.h"
#include "TakeSolve/SourceMotion.h"

#include <pybind11/pybind11.h>

#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

namespace CommandLine::Python
{

/// A take that was read, and from where.
struct VPythonTake
{
	std::string m_Path;
	std::shared_ptr<const TakeIO::VTake> m_pTake;
};

/// Names of a joint of the take and of the performer's segment that it drives.
using VJointNames = std::vector<std::pair<std::string, std::string>>;

TakeSolve::VSourceSettings ToSettings(const VJointNames& i_rJoints, std::optional<std::size_t> i_RestFrame);

/// The class Take: its joints, and a performer posed by its frames.
void DefineTakes(pybind11::module_& io_rModule);

} // namespace CommandLine::Python
