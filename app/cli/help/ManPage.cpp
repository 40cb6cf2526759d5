// Generates the man page from the option and command tables.

#include "ManPage.h"

#include "CompletedWords.h"

#include <algorithm>
#include <cstdint>

namespace gw {

namespace {

constexpr std::string_view kManHead =
    ".TH GAITWRIGHT 1 \"\" \"gaitwright " GAITWRIGHT_VERSION "\" \"User Commands\"\n"
    ".SH NAME\n"
    "gaitwright \\- convert motion capture to one fixed skeleton\n"
    ".SH SYNOPSIS\n"
    ".B gaitwright\n"
    ".I COMMAND\n"
    "[OPTIONS] FILES\n"
    ".SH DESCRIPTION\n"
    "Converts motions to the target skeleton of the host program.\n"
    "Results go to standard output, messages to standard error.\n"
    "Existing files are kept unless you pass --force or the command says that it replaces them.\n";

constexpr std::string_view kTail = ".SH FILES\n"
                                   ".TP\n"
                                   ".I BVH Profile\n"
                                   "Your own bone maps, in the documents folder.\n"
                                   ".SH SEE ALSO\n"
                                   ".BR GaitForge (1)\n";

// Escapes a text for man: no control characters, and minus signs that can be copied into a shell.
std::string Escaped(std::string_view text)
{
    std::string escaped;
    bool lineBegins = true;
    for (const char c : text)
    {
        if (lineBegins && (c == '.' || c == '\''))
            escaped += "\\&";
        if (c == '\\')
            escaped += "\\e";
        else if (c == '-')
            escaped += "\\-";
        else
            escaped += c;
        lineBegins = c == '\n';
    }
    return escaped;
}

std::string Bold(std::string_view text)
{
    return "\\fB" + Escaped(text) + "\\fR";
}

// Formats the value of an option, or the operands of a command.
std::string Slanted(std::string_view text)
{
    return text.empty() ? std::string() : " \\fI" + Escaped(text) + "\\fR";
}

// Formats "-o, --output OUT" and its description.
std::string OptionEntry(std::string_view names, std::string_view value, std::string_view help)
{
    std::string bold;
    for (const std::string_view name : Parts(names, ","))
        bold += (bold.empty() ? "" : ", ") + Bold(name);
    return ".TP\n" + bold + Slanted(value) + '\n' + Escaped(help) + '\n';
}

std::string OptionEntries(uint64_t bits)
{
    std::string text;
    for (const OptionRow& row : OptionTable())
        text += (bits & row.bit) != 0 ? OptionEntry(row.names, row.value, row.help) : std::string();
    return text;
}

// Options of every command, which the page lists once.
uint64_t SharedOptions()
{
    uint64_t shared = ~uint64_t{0};
    for (const ShellCommand& command : Commands())
        shared &= OptionsOf(command);
    return shared;
}

// The first line of a help text is a separate sentence; the rest is wrapped by hand.
std::string CommandEntry(const ShellCommand& command)
{
    const std::string_view help = command.help;
    const size_t firstEnd = std::min(help.find('\n'), help.size());
    const std::string_view rest = help.substr(std::min(firstEnd + 1, help.size()));
    return ".SS " + Escaped(command.name) + "\n.PP\n" + Bold(UsageLine(command)) + "\n.PP\n" +
           Escaped(help.substr(0, firstEnd)) + '\n' + (rest.empty() ? "" : ".PP\n" + Escaped(rest) + '\n') +
           OptionEntries(OptionsOf(command) & ~SharedOptions()) + ".PP\nExample:\n.PP\n.nf\n.RS\n" +
           Escaped(command.example) + "\n.RE\n.fi\n";
}

} // namespace

std::string ManPage()
{
    std::string page(kManHead);
    page += ".SH OPTIONS\nFor every command:\n" + OptionEntries(SharedOptions()) +
            OptionEntry("-h,--help", {}, "show the help of a command") +
            OptionEntry("--version", {}, "show the version; used without a command") + ".SH COMMANDS\n";
    for (const ShellCommand& command : Commands())
        page += CommandEntry(command);
    return page + ".SH EXIT STATUS\n" + std::string(kExitCodes) + '\n' + std::string(kTail);
}

} // namespace gw
