// Derives from the tables what can follow an option or be an operand, for all three shells.

#include "CompletedWords.h"

#include "Text.h"

#include <algorithm>

namespace gw {

namespace {

// Words in usage lines with a special meaning. Any other word is a file, or a number if it is parsed as one.
struct WordRow
{
    std::string_view name;
    EOffer offer;
    std::string_view words;
};
constexpr WordRow kWords[] = {
    {"DIR",       EOffer::Folders,  {}                   },
    {"FOLDER",    EOffer::Folders,  {}                   },
    {"SOURCE",    EOffer::Files,    "bvh htr cha chb orn"},
    {"RESULT",    EOffer::Files,    "kinetra htr orn bvh"},
    {"PAGE",      EOffer::Files,    "html htm"           },
    {"PLAN",      EOffer::Files,    "jsonl"              },
    {"REPORT",    EOffer::Files,    "jsonl"              },
    {"NAME|FILE", EOffer::Profiles, "prf"                },
};

CompletedWord WordOf(std::string_view name)
{
    const auto row = std::ranges::find(kWords, name, &WordRow::name);
    if (row == std::end(kWords))
        return {.name = name};
    return {.name = name, .offer = row->offer, .words = Parts(row->words, " ")};
}

bool IsText(const COptionTarget& target)
{
    return std::holds_alternative<std::string ShellOptions::*>(target);
}

} // namespace

CompletedWord ValueOf(const OptionRow& row)
{
    if (row.value.empty())
        return {.offer = EOffer::Nothing};
    if (!row.choices.empty())
        return {.name = row.value, .offer = EOffer::Choices, .words = Parts(row.choices, "|")};
    if (!IsText(row.target))
        return {.name = row.value, .offer = EOffer::Any};
    return WordOf(row.value);
}

std::vector<CompletedWord> OperandsOf(const ShellCommand& command)
{
    std::vector<CompletedWord> operands;
    for (const std::string_view text : Parts(command.operands, " "))
    {
        const size_t begin = text.find_first_not_of('[');
        CompletedWord word = WordOf(text.substr(begin, text.find_last_not_of(".]") + 1 - begin));
        word.optional = text.starts_with('[');
        word.repeated = text.find("...") != text.npos;
        operands.push_back(std::move(word));
    }
    return operands;
}

CompletedWord AnyOperandOf(const ShellCommand& command)
{
    CompletedWord any = {.offer = EOffer::Nothing};
    for (const CompletedWord& operand : OperandsOf(command))
    {
        if (any.offer == EOffer::Nothing)
            any = operand;
        else if (operand.offer != any.offer || operand.words.empty() || any.words.empty())
            return {}; // any file
        else
            any.words.insert(any.words.end(), operand.words.begin(), operand.words.end());
    }
    return any;
}

bool HasOption(const ShellCommand& command, const OptionRow& row)
{
    return (OptionsOf(command) & row.bit) != 0;
}

std::vector<std::string_view> Parts(std::string_view text, std::string_view delimiters)
{
    std::vector<std::string_view> parts;
    for (std::string_view part = NextToken(text, delimiters); !part.empty();
         part = NextToken(text, delimiters))
        parts.push_back(part);
    return parts;
}

std::string Joined(const std::vector<std::string_view>& words, std::string_view separator)
{
    std::string text;
    for (const std::string_view word : words)
        text += std::string(text.empty() ? std::string_view() : separator) + std::string(word);
    return text;
}

} // namespace gw
