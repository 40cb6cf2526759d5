// The table of options, and the help texts generated from it.

#include "OptionTable.h"

#include "Terminal.h"
#include "Text.h"

#include <algorithm>

namespace gw {

namespace {

constexpr uint64_t kEverywhere = kDataFolder | kJson | kQuiet;

constexpr OptionRow Row(EOption bit, std::string_view names, std::string_view value, COptionTarget target,
                        std::string_view help, std::string_view choices = {})
{
    return {bit, names, value, target, help, choices};
}

constexpr OptionRow kOptions[] = {
    Row(kOutput, "-o,--output", "OUT", &ShellOptions::output, "the file to write; - for standard output"),
    Row(kOutputFolder, "--out-dir", "DIR", &ShellOptions::outputFolder,
        "the folder to write to, created if it is missing"),
    Row(kProfile, "--profile", "NAME|FILE", &ShellOptions::profile,
        "an installed profile, or the path of a .prf file"),
    Row(kDraft, "--draft", "", &ShellOptions::draft,
        "if no installed profile fits, draft one, and use it if its main rows are sure"),
    Row(kDrafts, "--drafts", "DIR", &ShellOptions::drafts,
        "same as --draft, and keep the drafts in DIR; drafts found there are used"),
    Row(kMend, "--mend", "", &ShellOptions::mend,
        "read .bvh files repaired, as 'doctor --fix' would write them"),
    Row(kJob, "--job", "htr|orn", &ShellOptions::job,
        "htr converts every .bvh file, orn packages every .htr file", "htr|orn"),
    Row(kFrame, "--frame", "N", &ShellOptions::frame, "frame number, starting at 0"),
    Row(kAll, "--all", "", &ShellOptions::all,
        "write every frame to OUT: .csv, or .npy with OUT.positions.npy and OUT.names.txt"),
    Row(kTime, "--time", "T", &ShellOptions::time,
        "time in the units of the file's controls; may be negative"),
    Row(kObjects, "--objects", "", &ShellOptions::objects, "print all placed objects, not only nodes"),
    Row(kSize, "--size", "WxH", &ShellOptions::size, "width and height in pixels (default: 640x480)"),
    Row(kWith, "--with", "RESULT", &ShellOptions::with,
        "a second motion to draw next to it, at the same fraction of its length"),
    Row(kStrip, "--strip", "N", &ShellOptions::strip, "draw N poses in a row; a second motion goes below"),
    Row(kRate, "--rate", "R", &ShellOptions::rate,
        "frames per second, in place of the rate in the source; for 'package', the rate to store"),
    Row(kClip, "--clip", "NAME", &ShellOptions::clip,
        "the clip to read from an .fbx, .gltf, .glb, .vrm or .dae file (default: the longest)"),
    Row(kListClips, "--list-clips", "", &ShellOptions::listClips,
        "print the names of the clips, one per line"),
    Row(kFormat, "--format", "kinetra|htr|bvh|glb", &ShellOptions::format,
        "format of the result (default: by the name of the output, otherwise kinetra)",
        "kinetra|htr|bvh|glb"),
    Row(kFrames, "--frames", "A-B", &ShellOptions::frames,
        "write only these frames of the source; the first frame is 0"),
    Row(kInPlace, "--in-place", "", &ShellOptions::inPlace,
        "cancel the horizontal travel of the result; the height is kept"),
    Row(kMirror, "--mirror", "", &ShellOptions::mirror, "exchange left and right in the result"),
    Row(kAnimate, "--animate", "OUT", &ShellOptions::animate,
        "write an animated .png from the frame to the end of the motion, instead of -o"),
    Row(kView, "--view", "front|side|three-quarter|top", &ShellOptions::view,
        "direction from which the figure is drawn, by the way it faces (default: front)",
        "front|side|three-quarter|top"),
    Row(kBackground, "--background", "light|dark", &ShellOptions::background,
        "background of the picture (default: light)", "light|dark"),
    Row(kUpright, "--upright", "", &ShellOptions::upright,
        "turn a motion with another up axis than Y, such as Z, upright"),
    Row(kAxes, "--axes", "", &ShellOptions::axes, "draw the axes of every bone: X red, Y green, Z blue"),
    Row(kFrameScale, "--frame-scale", "F", &ShellOptions::frameScale,
        "write F times as many frames over the same time"),
    Row(kFix, "--fix", "OUT", &ShellOptions::fix,
        "write a repaired copy of the .bvh file; never overwrites the original"),
    Row(kNoLegs, "--no-legs", "", &ShellOptions::noLegs,
        "do not plant the feet where the source's feet are planted"),
    Row(kFaithful, "--faithful", "", &ShellOptions::faithful,
        "keep trunk, hips, knees and feet close to the source; pin planted feet; keep hands where they "
        "touch"),
    Row(kNoHands, "--no-hands", "", &ShellOptions::noHands,
        "with --faithful, leave the hands where the arms put them"),
    Row(kAlign, "--align", "", &ShellOptions::align,
        "point bones as in the source, whatever its rest pose; ignores the profile's offsets"),
    Row(kForce, "--force", "", &ShellOptions::force, "replace existing files"),
    Row(kSkipExisting, "--skip-existing", "", &ShellOptions::skipExisting,
        "skip sources whose output exists"),
    Row(kCheck, "--check", "", &ShellOptions::check,
        "measure each result against its source, as 'compare' does"),
    Row(kHtml, "--html", "PAGE", &ShellOptions::html,
        "write a page with measurements, curves over time and the worst frames"),
    Row(kKeepGoing, "--keep-going", "", &ShellOptions::keepGoing,
        "continue with the next source when one fails"),
    Row(kResume, "--resume", "", &ShellOptions::resume,
        "skip sources whose output is unchanged since an earlier --resume run"),
    Row(kJobs, "--jobs", "N", &ShellOptions::jobs, "number of worker processes (default: one per core)"),
    Row(kTimeLimit, "--time-limit", "S", &ShellOptions::timeLimit,
        "give up on a source after S seconds (default: 600)"),
    Row(kFilesFrom, "--files-from", "LIST", &ShellOptions::filesFrom,
        "read sources from a file, one per line; - for standard input"),
    Row(kNull, "-0,--null", "", &ShellOptions::nullSeparated,
        "names in the --files-from list are separated by zero bytes"),
    Row(kReport, "--report", "FILE", &ShellOptions::report,
        "write one line of JSON per source, in order: time, frames, profile, measurements, warnings"),
    Row(kShards, "--shards", "K", &ShellOptions::shards, "number of shards; plan at least one per machine"),
    Row(kShard, "--shard", "I", &ShellOptions::shard, "shard number, starting at 0"),
    Row(kDryRun, "--dry-run", "", &ShellOptions::dryRun,
        "show what would be done, but write nothing; with --verbose, for each source"),
    Row(kDataFolder, "--data-dir", "DIR", &ShellOptions::dataFolder,
        "use base.htr, KsBone.bsm and the stock profiles in DIR instead of the installed ones"),
    Row(kJson, "--json", "", &ShellOptions::json, "print results as JSON"),
    Row(kVerbose, "--verbose", "", &ShellOptions::verbose,
        "in a run over many files, print the result and the messages of each one"),
    Row(kQuiet, "--quiet", "", &ShellOptions::quiet, "print errors only"),
};

constexpr size_t kColumn = 26; // start of the second column of a help text

constexpr size_t kUsualWidth = 100; // of files and pipes
constexpr size_t kLeastWidth = 50;  // narrower columns are harder to read than wrapped lines

size_t HelpWidth()
{
    return IsTerminal(stdout) ? std::max(TerminalWidth(stdout), kLeastWidth) : kUsualWidth;
}

// Breaks a paragraph into lines that fit; those after the first are indented. Its own line breaks count as
// blanks.
std::string Wrapped(std::string_view text, size_t indent)
{
    const size_t width = HelpWidth();
    std::string wrapped;
    size_t column = indent;
    for (std::string_view word = NextToken(text, " \n"); !word.empty(); word = NextToken(text, " \n"))
    {
        const bool isFirst = wrapped.empty();
        const bool fits = isFirst || column + 1 + word.size() < width;
        if (!isFirst)
            wrapped += fits ? " " : '\n' + std::string(indent, ' ');
        column = (fits ? column + (isFirst ? 0 : 1) : indent) + word.size();
        wrapped += word;
    }
    return wrapped;
}

void AppendRow(std::string& text, std::string_view left, std::string_view right)
{
    std::string line = "  " + std::string(left);
    if (line.size() + 2 > kColumn)
        line += '\n' + std::string(kColumn, ' ');
    else
        line.resize(kColumn, ' ');
    text += line + Wrapped(right, kColumn) + '\n';
}

// Returns an option's names and value as shown in usage lines and help texts.
std::string Shown(const OptionRow& row, std::string_view names)
{
    return std::string(names) + (row.value.empty() ? "" : " ") + std::string(row.value);
}

std::string_view FirstLine(std::string_view text)
{
    return text.substr(0, text.find('\n'));
}

} // namespace

std::span<const OptionRow> OptionTable()
{
    return kOptions;
}

uint64_t OptionsOf(const ShellCommand& command)
{
    return command.options | kEverywhere;
}

std::string UsageLine(const ShellCommand& command)
{
    std::string line = "gaitwright " + std::string(command.name) + ' ' + std::string(command.operands);
    for (const OptionRow& row : kOptions)
    {
        if (command.required & row.bit)
            line += ' ' + Shown(row, row.names.substr(0, row.names.find(',')));
    }
    if (command.choice)
        line += ' ' + ChoiceText(command);
    return line + " [OPTIONS]";
}

std::string ChoiceText(const ShellCommand& command)
{
    std::string text;
    for (const OptionRow& row : kOptions)
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
    for (const ShellCommand& command : Commands())
        AppendRow(text, command.name, FirstLine(command.help));
    text += "\n'gaitwright COMMAND --help' shows the options of a command and an example.\n"
            "Exit codes: " +
            std::string(kExitCodes) + "\n\nExample:\n  ";
    return text + std::string(Commands().front().example) + '\n';
}

std::string CommandHelp(const ShellCommand& command)
{
    const std::string_view first = FirstLine(command.help);
    std::string text = "Usage: " + UsageLine(command) + "\n\n" + Wrapped(first, 0) + '\n';
    for (std::string_view rest = command.help.substr(first.size()); !rest.empty();)
    {
        const size_t end = std::min(rest.find("\n\n", 1), rest.size());
        text += '\n' + Wrapped(rest.substr(0, end), 0) + '\n';
        rest.remove_prefix(end);
    }
    text += "\nOptions:\n";
    for (const OptionRow& row : kOptions)
    {
        if (OptionsOf(command) & row.bit)
            AppendRow(text, Shown(row, row.names), row.help);
    }
    AppendRow(text, "-h,--help", "show this help");
    return text + "\nExample:\n  " + std::string(command.example) + '\n';
}

} // namespace gw
