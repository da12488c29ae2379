#pragma once

#include <cstddef>

/// What a file may ask for before it is refused.
namespace UtilsRapidXml
{

/// Elements within elements. The parser and the walk over the nodes both recurse: this keeps either within a stack of
/// 512 KiB, and a skeleton's chain is shorter by an order of magnitude.
inline constexpr std::size_t c_MaximumDepth = 512;

/// Bytes that a text and the nodes made of it may take together: "<a/>" grows to 24 times its size, and a file that is
/// refused later must not have cost more than 128 MB.
inline constexpr std::size_t c_MaximumDocumentBytes = 96u << 20;

/// Bytes of all errors, and of all warnings, of one document: a path is up to 512 names long, and an unknown attribute
/// of five bytes repeats it. What goes beyond is counted and told as one number.
inline constexpr std::size_t c_MaximumMessageBytes = 1u << 20;

} // namespace UtilsRapidXml
