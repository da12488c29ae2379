#pragma once

#include <set>
#include <string>

/// The first rule of glTF 2.0 that a binary file breaks, of those that readers stumble over: chunks, bounds, alignment,
/// least and greatest values, indices, trees, skins, unit quaternions, times, pictures. Empty if it breaks none.
std::string BrokenGltfRule(const std::string& i_rBytes);

/// The names of the nodes that anything moves.
std::set<std::string> AnimatedNodes(const std::string& i_rBytes);
