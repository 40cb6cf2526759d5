#include "OptionTable.h"

#include <algorithm>

namespace gw {

namespace {

constexpr uint32_t kEverywhere = kDataFolder | kJson | kQuiet;

constexpr COptionRow kOptions[] = {
    {kOutput,       "-o,--output", "OUT",            "the file to write",                                            &COptions::output},
    {kOutputFolder, "--out-dir",   "DIR",            "the folder to write to, made where it is missing",
     &COptions::outputFolder                                                                                                          },
    {kProfile,      "--profile",   "NAME|FILE",      "an installed profile by its name, or the path of a .prf file",
     &COptions::profile                                                                                                               },
    {kJob,          "--job",       "htr|orn",        "htr converts every .bvh, orn packages every .htr",             &COptions::job,    "htr|orn"},
    {kFrame,             "--frame",                     "N",                "the number of the frame, from 0 on",                                                       &COptions::frame                    },
    {kRate,             "--rate",                      "R",                  "frames per second, as the package tells its reader",                                                        &COptions::rate},
    {kFrameScale,             "--frame-scale",                "F",     "F times as many frames in the same time",                                                 &COptions::frameScale                                     },
    {kNoLegs,             "--no-legs",                    "",             "do not plant the feet where the source's stand",                                                      &COptions::noLegs},
    {kForce,             "--force",                     "",                "replace a file that exists",                                                        &COptions::force                                                        },
    {kSkipExisting,             "--skip-existing",              "", "pass over a source whose output exists",                                                &COptions::skipExisting},
    {kKeepGoing,             "--keep-going",                 "",       "go on with the next source where one fails",                                                   &COptions::keepGoing                                                 },
    {kDryRun,             "--dry-run",                    "",             "say what would be done, and write nothing",                                                      &COptions::dryRun},
    {kDataFolder,             "--data-dir",                "DIR",
     "the folder of base.htr, KsBone.bsm and the stock profiles, in place of the program's own",                                                  &COptions::dataFolder                                       },
    {kJson,             "--json",                      "",                  "results as JSON",                                                         &COptions::json},
    {kQuiet,             "--quiet",                     "",                "no words but those of failures",                                                        &COptions::quiet                         },
};

constexpr size_t kColumn = 26; // where the second column of a help begins

void AppendRow(std::string& text, std::string_view left, std::string_view right)
{
    std::string line = "  " + std::string(left);
    if (line.size() + 2 > kColumn)
        line += '\n' + std::string(kColumn, ' ');
    else
        line.resize(kColumn, ' ');
    text += line + std::string(right) + '\n';
}

// The option as a usage line or a help shows it: its names and what stands behind.
std::string Shown(const COptionRow& row, std::string_view names)
{
    return std::string(names) + (row.value.empty() ? "" : " ") + std::string(row.value);
}

std::string_view FirstLine(std::string_view text)
{
    return text.substr(0, text.find('\n'));
}

} // namespace

std::span<const COptionRow> OptionTable()
{
    return kOptions;
}

uint32_t OptionsOf(const CCommand& command)
{
    return command.options | kEverywhere;
}

std::string UsageLine(const CCommand& command)
{
    std::string line = "gaitwright " + std::string(command.name) + ' ' + std::string(command.operands);
    for (const COptionRow& row : kOptions)
    {
        if (command.required & row.bit)
            line += ' ' + Shown(row, row.names.substr(0, row.names.find(',')));
    }
    return line + " [OPTIONS]";
}

std::string ProgramHelp()
{
    std::string text = "Usage: gaitwright COMMAND [OPTIONS] FILES\n\n"
                       "Converts motions to the target skeleton of the host program.\n\nCommands:\n";
    for (const CCommand& command : Commands())
        AppendRow(text, command.name, FirstLine(command.help));
    text += "\n'gaitwright COMMAND --help' shows the options of a command and an example.\n"
            "Exit codes: 0 done, 1 some work failed, 2 wrong usage.\n\nExample:\n  ";
    return text + std::string(Commands().front().example) + '\n';
}

std::string CommandHelp(const CCommand& command)
{
    std::string text = "Usage: " + UsageLine(command) + "\n\n" + std::string(command.help) + "\n\nOptions:\n";
    for (const COptionRow& row : kOptions)
    {
        if (OptionsOf(command) & row.bit)
            AppendRow(text, Shown(row, row.names), row.help);
    }
    AppendRow(text, "-h,--help", "this text");
    return text + "\nExample:\n  " + std::string(command.example) + '\n';
}

} // namespace gw
