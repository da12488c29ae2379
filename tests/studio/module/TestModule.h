#pragma once

#include <string>
#include <vector>

/// What happened to the test module and its panels, in order. The module and the test each have the function by its
/// name, "TestModuleCalls".
using VTestModuleCalls = std::vector<std::string>&();
