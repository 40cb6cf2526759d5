#pragma once

#include "CommandTable.h"

#include <span>
#include <variant>

namespace gw {

/// The field that receives an option's value, whose type is also the type of the option: a switch, a text, a
/// positive number, any number, an integer, a non-negative integer, a size.
using COptionTarget = std::variant<bool ShellOptions::*, std::string ShellOptions::*, float ShellOptions::*,
                                   std::optional<float> ShellOptions::*, int64_t ShellOptions::*,
                                   std::optional<int64_t> ShellOptions::*, PixelSize ShellOptions::*>;

/// An option of the program.
struct OptionRow
{
    EOption bit;
    std::string_view names; ///< "-o,--output"
    std::string_view value; ///< the value's name in the help; empty for a switch
    COptionTarget target;
    std::string_view help;
    std::string_view choices; ///< allowed values, separated by "|"; empty for any
};

/// Returns the options, in help order.
std::span<const OptionRow> OptionTable();

/// Meaning of the exit codes.
inline constexpr std::string_view kExitCodes = "0 done, 1 some work failed, 2 wrong usage, 130 interrupted.";

/// Returns the bits of all options of a command.
uint64_t OptionsOf(const ShellCommand& command);

/// Returns the program's help: one line per command.
std::string ProgramHelp();
/// Returns a command's help: usage, description, options, example.
std::string CommandHelp(const ShellCommand& command);
/// Returns "gaitwright pose FILE --frame N [OPTIONS]".
std::string UsageLine(const ShellCommand& command);
/// Returns the options of which a command needs exactly one: "--frame N | --time T".
std::string ChoiceText(const ShellCommand& command);

} // namespace gw
