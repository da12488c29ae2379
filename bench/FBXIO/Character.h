#pragma once

#include <string>

/// A character as exporters write it, in binary 7.4 with deflated arrays, above 5 MB: 66 bones; body, clothes and hair
/// of some 90,000 control points and four bones each; normals by polygon vertex, edges, smoothing, texture coordinates
/// with a seam, and for each a material with a texture that is not beside the file. No animation. The same bytes at
/// every call.
std::string GeneratedCharacter();
