#include "OptionTable.h"

namespace gw {

namespace {

constexpr uint64_t kEverywhere = kDataFolder | kJson | kQuiet;

constexpr COptionRow Row(EOption bit, std::string_view names, std::string_view value, COptionTarget target,
                         std::string_view help, std::string_view choices = {})
{
    return {bit, names, value, target, help, choices};
}

constexpr COptionRow kOptions[] = {
    Row(kOutput, "-o,--output", "OUT", &COptions::output, "the file to write"),
    Row(kOutputFolder, "--out-dir", "DIR", &COptions::outputFolder,
        "the folder to write to, created if it is missing"),
    Row(kProfile, "--profile", "NAME|FILE", &COptions::profile,
        "an installed profile, or the path of a .prf file"),
    Row(kJob, "--job", "htr|orn", &COptions::job, "htr converts every .bvh file, orn packages every .htr file",
        "htr|orn"),
    Row(kFrame, "--frame", "N", &COptions::frame, "frame number, starting at 0"),
    Row(kTime, "--time", "T", &COptions::time, "time in the units of the file's controls; may be negative"),
    Row(kObjects, "--objects", "", &COptions::objects, "print all placed objects, not only nodes"),
    Row(kSize, "--size", "WxH", &COptions::size, "width and height in pixels (default: 640x480)"),
    Row(kWith, "--with", "RESULT", &COptions::with,
        "a second motion to draw next to it, at the same fraction of its length"),
    Row(kStrip, "--strip", "N", &COptions::strip, "draw N poses in a row; a second motion goes below"),
    Row(kRate, "--rate", "R", &COptions::rate, "frames per second to store in the package"),
    Row(kFrameScale, "--frame-scale", "F", &COptions::frameScale, "write F times as many frames over the same time"),
    Row(kFix, "--fix", "OUT", &COptions::fix, "write a repaired copy of the .bvh file; never overwrites the original"),
    Row(kNoLegs, "--no-legs", "", &COptions::noLegs, "do not plant the feet where the source's feet are planted"),
    Row(kFaithful, "--faithful", "", &COptions::faithful,
        "keep hips, knees and feet close to the source; pin planted feet"),
    Row(kAlign, "--align", "", &COptions::align,
        "point bones as in the source, whatever its rest pose; ignores the profile's offsets"),
    Row(kForce, "--force", "", &COptions::force, "replace existing files"),
    Row(kSkipExisting, "--skip-existing", "", &COptions::skipExisting,
        "skip sources whose output exists"),
    Row(kCheck, "--check", "", &COptions::check, "measure each result against its source, as 'compare' does"),
    Row(kHtml, "--html", "PAGE", &COptions::html,
        "write a page with measurements, curves over time and the worst frames"),
    Row(kKeepGoing, "--keep-going", "", &COptions::keepGoing, "continue with the next source when one fails"),
    Row(kResume, "--resume", "", &COptions::resume,
        "skip sources whose output is unchanged since an earlier --resume run"),
    Row(kJobs, "--jobs", "N", &COptions::jobs, "number of worker processes (default: one per core)"),
    Row(kTimeLimit, "--time-limit", "S", &COptions::timeLimit,
        "give up on a source after S seconds (default: 600)"),
    Row(kFilesFrom, "--files-from", "LIST", &COptions::filesFrom,
        "read sources from a file, one per line; - for standard input"),
    Row(kNull, "-0,--null", "", &COptions::nullSeparated, "names in the --files-from list are separated by zero bytes"),
    Row(kReport, "--report", "FILE", &COptions::report,
        "write one line of JSON per source, in order: time, frames, profile, measurements, warnings"),
    Row(kShards, "--shards", "K", &COptions::shards, "number of shards; plan at least one per machine"),
    Row(kShard, "--shard", "I", &COptions::shard, "shard number, starting at 0"),
    Row(kDryRun, "--dry-run", "", &COptions::dryRun, "show what would be done, but write nothing"),
    Row(kDataFolder, "--data-dir", "DIR", &COptions::dataFolder,
        "use base.htr, KsBone.bsm and the stock profiles in DIR instead of the installed ones"),
    Row(kJson, "--json", "", &COptions::json, "print results as JSON"),
    Row(kQuiet, "--quiet", "", &COptions::quiet, "print errors only"),
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

// The option as shown in a usage line or a help text: its names and its value.
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

uint64_t OptionsOf(const CCommand& command)
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
    if (command.choice)
        line += ' ' + ChoiceText(command);
    return line + " [OPTIONS]";
}

std::string ChoiceText(const CCommand& command)
{
    std::string text;
    for (const COptionRow& row : kOptions)
    {
        if (!(command.choice & row.bit))
            continue;
        if (!text.empty())
            text += " | ";
        text += Shown(row, row.names);
    }
    return text;
}

std::string ProgramHelp()
{
    std::string text = "Usage: gaitwright COMMAND [OPTIONS] FILES\n\n"
                       "Converts motions to the target skeleton of the host program.\n\nCommands:\n";
    for (const CCommand& command : Commands())
        AppendRow(text, command.name, FirstLine(command.help));
    text += "\n'gaitwright COMMAND --help' shows the options of a command and an example.\n"
            "Exit codes: " +
            std::string(kExitCodes) + "\n\nExample:\n  ";
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
    AppendRow(text, "-h,--help", "show this help");
    return text + "\nExample:\n  " + std::string(command.example) + '\n';
}

} // namespace gw
