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
        "the folder to write to, made where it is missing"),
    Row(kProfile, "--profile", "NAME|FILE", &COptions::profile,
        "an installed profile, or the path of a .prf file"),
    Row(kJob, "--job", "htr|orn", &COptions::job, "htr converts every .bvh, orn packages every .htr",
        "htr|orn"),
    Row(kFrame, "--frame", "N", &COptions::frame, "the number of the frame, from 0 on"),
    Row(kTime, "--time", "T", &COptions::time, "a time as the controls of the file count it; may be below 0"),
    Row(kObjects, "--objects", "", &COptions::objects, "all objects with a place, and not nodes alone"),
    Row(kSize, "--size", "WxH", &COptions::size, "width and height in pixels, 640x480 unless told"),
    Row(kWith, "--with", "RESULT", &COptions::with,
        "the motion to draw beside it, at the same share of its length"),
    Row(kStrip, "--strip", "N", &COptions::strip, "N poses in a row; two motions one under the other"),
    Row(kRate, "--rate", "R", &COptions::rate, "frames per second, as the package tells its reader"),
    Row(kFrameScale, "--frame-scale", "F", &COptions::frameScale, "F times as many frames in the same time"),
    Row(kFix, "--fix", "OUT", &COptions::fix, "write a mended copy of the .bvh, never over itself"),
    Row(kNoLegs, "--no-legs", "", &COptions::noLegs, "do not plant the feet where the source's stand"),
    Row(kFaithful, "--faithful", "", &COptions::faithful,
        "let hips, knees and feet keep to the source, and let feet stand still where its feet stand"),
    Row(kAlign, "--align", "", &COptions::align,
        "let bones point as the source's do, whatever its rest pose; the profile's offsets have no say"),
    Row(kForce, "--force", "", &COptions::force, "replace a file that exists"),
    Row(kSkipExisting, "--skip-existing", "", &COptions::skipExisting,
        "pass over a source whose output exists"),
    Row(kCheck, "--check", "", &COptions::check, "measure each result against its source, as 'compare' does"),
    Row(kHtml, "--html", "PAGE", &COptions::html,
        "write a page with figures, curves over time and the worst frames"),
    Row(kKeepGoing, "--keep-going", "", &COptions::keepGoing, "go on with the next source where one fails"),
    Row(kResume, "--resume", "", &COptions::resume,
        "pass over a source whose output stands as an earlier --resume run made it"),
    Row(kJobs, "--jobs", "N", &COptions::jobs, "worker processes; as many as there are cores unless told"),
    Row(kTimeLimit, "--time-limit", "S", &COptions::timeLimit,
        "seconds after which a source that hangs is given up; 600 unless told"),
    Row(kFilesFrom, "--files-from", "LIST", &COptions::filesFrom,
        "a file with a source on each line, - for standard input"),
    Row(kNull, "-0,--null", "", &COptions::nullSeparated, "the list has zero bytes between its names"),
    Row(kReport, "--report", "FILE", &COptions::report,
        "write a line of JSON for every source, in order: time, frames, profile, figures, warnings"),
    Row(kShards, "--shards", "K", &COptions::shards, "how many parts, for as many machines or more"),
    Row(kShard, "--shard", "I", &COptions::shard, "which part, from 0 on"),
    Row(kDryRun, "--dry-run", "", &COptions::dryRun, "say what would be done, and write nothing"),
    Row(kDataFolder, "--data-dir", "DIR", &COptions::dataFolder,
        "the folder of base.htr, KsBone.bsm and the stock profiles, in place of the program's own"),
    Row(kJson, "--json", "", &COptions::json, "results as JSON"),
    Row(kQuiet, "--quiet", "", &COptions::quiet, "no words but those of failures"),
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
    AppendRow(text, "-h,--help", "this text");
    return text + "\nExample:\n  " + std::string(command.example) + '\n';
}

} // namespace gw
