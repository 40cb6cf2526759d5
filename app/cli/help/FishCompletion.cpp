#include "CompletedWords.h"
#include "Completion.h"

namespace gw {

namespace {

constexpr std::string_view kFishHead =
    R"fish(# fish completion for gaitwright, written by 'gaitwright --completion fish'

complete -c gaitwright -f
complete -c gaitwright -n __fish_use_subcommand -s h -l help -d 'the commands'
complete -c gaitwright -n __fish_use_subcommand -l version -d 'of the program'
)fish";

constexpr std::string_view kProfiles =
    R"fish( -r -F -a "(gaitwright profiles 2>/dev/null | string replace -r ' \((stock|own), .*' '')")fish";

std::string FishQuoted(std::string_view text)
{
    std::string quoted = "'";
    for (const char c : text)
    {
        if (c == '\'' || c == '\\')
            quoted += '\\';
        quoted += c;
    }
    return quoted + '\'';
}

std::string Offer(const CompletedWord& word)
{
    switch (word.offer)
    {
    case EOffer::Nothing:
        return {};
    case EOffer::Any:
        return " -x";
    case EOffer::Choices:
        return " -x -a " + FishQuoted(Joined(word.words, " "));
    case EOffer::Folders:
        return " -x -a '(__fish_complete_directories)'";
    case EOffer::Profiles:
        return std::string(kProfiles);
    case EOffer::Files:
        break;
    }
    return " -r -F";
}

// A line starts with the commands that it applies to.
std::string Line(const std::string& commands)
{
    return "complete -c gaitwright -n '__fish_seen_subcommand_from" + commands + '\'';
}

std::string OptionLine(const OptionRow& row)
{
    std::string commands, names;
    for (const ShellCommand& command : Commands())
        commands += HasOption(command, row) ? ' ' + std::string(command.name) : std::string();
    for (const std::string_view name : Parts(row.names, ","))
    {
        const bool isLong = name.starts_with("--");
        names += std::string(isLong ? " -l " : " -s ") + std::string(name.substr(isLong ? 2 : 1));
    }
    return Line(commands) + names + Offer(ValueOf(row)) + " -d " + FishQuoted(row.help) + '\n';
}

std::string CommandLines(const ShellCommand& command)
{
    const std::string name(command.name);
    const bool takesFolder = AnyOperandOf(command).offer == EOffer::Folders;
    return "complete -c gaitwright -n __fish_use_subcommand -a " + name + " -d " +
           FishQuoted(command.help.substr(0, command.help.find('\n'))) + '\n' + Line(' ' + name) +
           (takesFolder ? " -a '(__fish_complete_directories)'" : " -F") + '\n';
}

} // namespace

std::string FishCompletion()
{
    std::string text(kFishHead);
    for (const ShellCommand& command : Commands())
        text += CommandLines(command);
    for (const OptionRow& row : OptionTable())
        text += OptionLine(row);
    return text;
}

} // namespace gw
