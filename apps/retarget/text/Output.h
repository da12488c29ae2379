#pragma once

#include <nlohmann/json.hpp>

#include <string>
#include <string_view>

namespace CommandLine
{

using VJson = nlohmann::ordered_json;

/// Prints a result on standard output; throws VCommandError with EBadOutput if not all of it arrives.
void Print(std::string_view i_Text);

/// Prints a value as indented JSON; numbers that are not finite become null, bytes that are no UTF-8 a replacement
/// character.
void PrintJson(const VJson& i_rValue);

/// The JSON with --json, without it the text.
void PrintResult(const VJson& i_rJson, std::string_view i_Text);

/// The value as PrintJson prints it: one line for a value that holds only scalars.
std::string JsonText(const VJson& i_rValue);

/// Text for people: bytes that would drive a terminal become blanks.
std::string Printable(std::string_view i_Text);

} // namespace CommandLine
