#pragma once

#include "OptionTable.h"

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// What a shell offers where a word of the command line is due.
enum class EOffer : uint8_t
{
    Nothing, ///< a switch takes no word
    Any,     ///< a number, or what only the user knows
    Choices, ///< the words of `words`
    Files,   ///< those with an extension of `words`, without dots and in lower case; all where there is none
    Folders,
    Profiles, ///< installed profiles by their names, and files as above
};

/// An offer, with its words, which are those of the tables.
struct CompletedWord
{
    std::string_view name = {}; ///< as the help shows it: "SOURCE"
    EOffer offer = EOffer::Files;
    std::vector<std::string_view> words = {};
    bool optional = false;
    bool repeated = false;
};

/// What may stand behind an option.
CompletedWord ValueOf(const OptionRow& row);
/// A command's operands, in their order.
std::vector<CompletedWord> OperandsOf(const ShellCommand& command);
/// What any of them may be, for shells that do not tell which one a word is.
CompletedWord AnyOperandOf(const ShellCommand& command);
/// Whether a command takes an option.
bool HasOption(const ShellCommand& command, const OptionRow& row);
/// The parts of a text, as of an option's names or choices.
std::vector<std::string_view> Parts(std::string_view text, std::string_view delimiters);
/// Words in a row with a separator between them.
std::string Joined(const std::vector<std::string_view>& words, std::string_view separator);

} // namespace gw
