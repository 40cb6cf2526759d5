// Generates the completion script for zsh from the option and command tables.

#include "CompletedWords.h"
#include "Completion.h"

namespace gw {

namespace {

constexpr std::string_view kZshHead = R"zsh(#compdef gaitwright
# zsh completion for gaitwright, written by 'gaitwright --completion zsh'

_gaitwright_profiles() {
    local -a names
    names=(${(f)"$($service profiles 2>/dev/null | sed -E 's/ \((stock|own), .*//')"})
    _wanted profiles expl profile compadd -a names
    _files -g "*.prf"
}

_gaitwright() {
    local -a commands
)zsh";

// Quotes a text within single quotes, inside the brackets of an _arguments word.
std::string ZshQuoted(std::string_view text)
{
    std::string quoted;
    for (const char c : text)
    {
        if (c == '[' || c == ']' || c == ':')
            quoted += '\\';
        quoted += c == '\'' ? std::string("'\\''") : std::string(1, c);
    }
    return quoted;
}

// Returns ":SOURCE:_files ...".
std::string Action(const CompletedWord& word)
{
    const std::string message = ':' + ZshQuoted(word.name) + ':';
    switch (word.offer)
    {
    case EOffer::Nothing:
        return {};
    case EOffer::Any:
        return message + ' ';
    case EOffer::Choices:
        return message + '(' + Joined(word.words, " ") + ')';
    case EOffer::Folders:
        return message + "_files -/";
    case EOffer::Profiles:
        return message + "_gaitwright_profiles";
    case EOffer::Files:
        break;
    }
    return message +
           (word.words.empty() ? "_files" : "_files -g \"*.(#i)(" + Joined(word.words, "|") + ")\"");
}

// Returns "'(-o --output)'{-o,--output}'[the file to write]:OUT:_files'".
std::string OptionWord(const OptionRow& row)
{
    const std::vector<std::string_view> names = Parts(row.names, ",");
    const std::string rest = '[' + ZshQuoted(row.help) + ']' + Action(ValueOf(row)) + '\'';
    if (names.size() == 1)
        return '\'' + std::string(names[0]) + rest;
    return "'(" + Joined(names, " ") + ")'{" + std::string(row.names) + "}'" + rest;
}

std::string OperandWords(const ShellCommand& command)
{
    std::string text;
    size_t position = 0;
    for (const CompletedWord& operand : OperandsOf(command))
    {
        const std::string place = operand.repeated ? "*" : std::to_string(++position);
        text += " \\\n            '" + place + (operand.optional && !operand.repeated ? ":" : "") +
                Action(operand) + '\'';
    }
    return text;
}

std::string CommandCase(const ShellCommand& command)
{
    std::string text = "    " + std::string(command.name) + ")\n        _arguments";
    for (const OptionRow& row : OptionTable())
        text += HasOption(command, row) ? " \\\n            " + OptionWord(row) : std::string();
    return text + " \\\n            '(-h --help)'{-h,--help}'[show the help of the command]'" +
           OperandWords(command) + "\n        ;;\n";
}

} // namespace

std::string ZshCompletion()
{
    std::string names, cases;
    for (const ShellCommand& command : Commands())
    {
        const std::string_view help = command.help.substr(0, command.help.find('\n'));
        names += "        '" + std::string(command.name) + ':' + ZshQuoted(help) + "'\n";
        cases += CommandCase(command);
    }
    return std::string(kZshHead) + "    commands=(\n" + names +
           "    )\n    if ((CURRENT == 2)); then\n        _describe command commands\n        return\n    "
           "fi\n"
           "    shift words\n    ((CURRENT--))\n    case $words[1] in\n" +
           cases + "    esac\n}\n\n_gaitwright \"$@\"\n";
}

} // namespace gw
