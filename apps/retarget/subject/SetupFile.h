#pragma once

#include "SetupIO/Setup.h"

#include <initializer_list>
#include <string>
#include <string_view>

/// Files that hold the text of a set-up. All throw VCommandError with EBadInput to fail, with the line and the reason.
namespace CommandLine
{

/// @param i_pUse what it is to be: "a preset".
std::string ReadSetupText(const std::string& i_rPath, const char* i_pUse);

/// @param i_Fields that it may have.
SetupIO::VSetup ParseSetup(const std::string& i_rText, const std::string& i_rPath,
    std::initializer_list<std::string_view> i_Fields, const char* i_pUse);

/// A path that a text gives, from where the program runs: relative to the text's folder, unless it is absolute.
std::string PathBeside(const std::string& i_rTextPath, const std::string& i_rPath);

} // namespace CommandLine
