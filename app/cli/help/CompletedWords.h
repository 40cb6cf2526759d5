#pragma once

#include "OptionTable.h"

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// What a shell offers for a word of the command line.
enum class EOffer : uint8_t
{
    Nothing, ///< switches have no value
    Any,     ///< a number, or something only the user knows
    Choices, ///< the words in `words`
    Files,   ///< files with an extension in `words` (without dots, lowercase); all files if empty
    Folders,
    Profiles, ///< names of installed profiles, and files as above
};

/// An offer and its words, which come from the tables.
struct CompletedWord
{
    std::string_view name = {}; ///< as shown in the help: "SOURCE"
    EOffer offer = EOffer::Files;
    std::vector<std::string_view> words = {};
    bool optional = false;
    bool repeated = false;
};

/// Returns what can follow an option.
CompletedWord ValueOf(const OptionRow& row);
/// Returns a command's operands, in order.
std::vector<CompletedWord> OperandsOf(const ShellCommand& command);
/// Returns what any operand can be, for shells that do not report a word's position.
CompletedWord AnyOperandOf(const ShellCommand& command);
/// Returns whether a command has an option.
bool HasOption(const ShellCommand& command, const OptionRow& row);
/// Splits a text, such as an option's names or choices.
std::vector<std::string_view> Parts(std::string_view text, std::string_view delimiters);
/// Joins words with a separator.
std::string Joined(const std::vector<std::string_view>& words, std::string_view separator);

} // namespace gw
