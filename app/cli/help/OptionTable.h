#pragma once

#include "CommandTable.h"

#include <span>
#include <variant>

namespace gw {

/// Where an option's value goes, which also says what it is: a switch, a text, a number above 0, any number,
/// an integer, a whole number from 0 on, a size.
using COptionTarget = std::variant<bool COptions::*, std::string COptions::*, float COptions::*,
                                   std::optional<float> COptions::*, int64_t COptions::*,
                                   std::optional<int64_t> COptions::*, CPixelSize COptions::*>;

/// One option of the program.
struct COptionRow
{
    EOption bit;
    std::string_view names; ///< "-o,--output"
    std::string_view value; ///< what stands behind it, as the help shows it; empty for a switch
    COptionTarget target;
    std::string_view help;
    std::string_view choices; ///< the words that may stand behind it, with "|" between them; empty for any
};

/// The table of options, in the order of the help.
std::span<const COptionRow> OptionTable();

/// What the program's answer to the shell means.
inline constexpr std::string_view kExitCodes = "0 done, 1 some work failed, 2 wrong usage, 130 interrupted.";

/// The bits of all options that a command takes.
uint64_t OptionsOf(const CCommand& command);

/// The help of the program: every command with a line.
std::string ProgramHelp();
/// The help of a command: usage, what it does, options, an example.
std::string CommandHelp(const CCommand& command);
/// "gaitwright pose FILE --frame N [OPTIONS]".
std::string UsageLine(const CCommand& command);
/// The options that a command takes one of: "--frame N | --time T".
std::string ChoiceText(const CCommand& command);

} // namespace gw
