#pragma once

#include "CommandTable.h"

#include <span>
#include <variant>

namespace gw {

/// Where an option's value goes, which also says what it is: a switch, a text, a number above 0, any number,
/// an integer, a whole number from 0 on, a size.
using COptionTarget = std::variant<bool ShellOptions::*, std::string ShellOptions::*, float ShellOptions::*,
                                   std::optional<float> ShellOptions::*, int64_t ShellOptions::*,
                                   std::optional<int64_t> ShellOptions::*, PixelSize ShellOptions::*>;

/// One option of the program.
struct OptionRow
{
    EOption bit;
    std::string_view names; ///< "-o,--output"
    std::string_view value; ///< what stands behind it, as the help shows it; empty for a switch
    COptionTarget target;
    std::string_view help;
    std::string_view choices; ///< the words that may stand behind it, with "|" between them; empty for any
};

/// The table of options, in the order of the help.
std::span<const OptionRow> OptionTable();

/// What the program's answer to the shell means.
inline constexpr std::string_view kExitCodes = "0 done, 1 some work failed, 2 wrong usage, 130 interrupted.";

/// The bits of all options that a command takes.
uint64_t OptionsOf(const ShellCommand& command);

/// The help of the program: every command with a line.
std::string ProgramHelp();
/// The help of a command: usage, what it does, options, an example.
std::string CommandHelp(const ShellCommand& command);
/// "gaitwright pose FILE --frame N [OPTIONS]".
std::string UsageLine(const ShellCommand& command);
/// The options that a command takes one of: "--frame N | --time T".
std::string ChoiceText(const ShellCommand& command);

} // namespace gw
