// The table of commands. Parsing, help, man page and completion are all generated from it.

#include "CommandTable.h"

#include <algorithm>

namespace gw {

namespace {

// Rows are function calls, because the formatter keeps their layout.
constexpr ShellCommand Row(std::string_view name, std::string_view operands, uint64_t options,
                           uint64_t required, EExit (*run)(const ShellOptions&), std::string_view help,
                           std::string_view example, uint64_t choice = 0)
{
    return {name, operands, options, required, run, help, example, choice};
}

// Options of runs over many files.
constexpr uint64_t kManyOptions = kJobs | kFilesFrom | kNull | kResume | kReport | kTimeLimit | kVerbose;

// Options that get more files through, and more faithfully.
constexpr uint64_t kHelpOptions = kAlign | kFaithful | kNoHands | kDraft | kDrafts | kMend | kCheck;

constexpr uint64_t kConvertOptions = kOutput | kOutputFolder | kProfile | kNoLegs | kHelpOptions | kForce |
                                     kSkipExisting | kDryRun | kKeepGoing | kHtml | kManyOptions | kRate |
                                     kClip | kFormat | kFrames | kInPlace | kMirror;

constexpr uint64_t kBatchOptions = kJob | kProfile | kOutputFolder | kHelpOptions | kKeepGoing | kManyOptions;

// Conversion options that are fixed when a run is planned; the rest are given when it runs.
constexpr uint64_t kPlanOptions =
    (kConvertOptions & ~(kSkipExisting | kDryRun | kKeepGoing | kHtml | kManyOptions)) | kFilesFrom | kNull |
    kShards;

constexpr uint64_t kRenderOptions = kOutput | kFrame | kSize | kWith | kStrip | kForce | kSkipExisting |
                                    kView | kBackground | kUpright | kAxes | kAnimate | kRate | kClip;

constexpr ShellCommand kCommands[] = {
    Row("convert", "SOURCE...", kConvertOptions, 0, RunConvert,
        "Convert a motion to the target skeleton and save it as a Kinetra file.\n"
        "Without --profile, the matching stock profile is used, or else the installed profile that matches\n"
        "best: all of its rows must match, and the most rows win. The result line names the chosen profile\n"
        "and its confidence. A profile that confuses left and right, or arm and clavicle, is used only if\n"
        "you name it. If the names in the source share a prefix (Model_, mixamorig3:), it is added to those\n"
        "of the profile.\n\n"
        "--draft makes a profile if no installed one fits, as 'gaitwright suggest' does. --mend reads a\n"
        "damaged .bvh file repaired, as 'gaitwright doctor --fix' does. The result line says so.\n\n"
        "OUT can end in .Kinetra, .htr, .bvh or .glb, or be a folder; --format selects the same. SOURCE and "
        "OUT\n"
        "can be - for standard input and output. --frames, --in-place and --mirror change the result after\n"
        "it was measured. Of a file with several clips, the longest is converted unless you pass --clip; in\n"
        "a folder, each clip becomes a result.\n\n"
        "Several sources, or a folder, need "
        "--out-dir;\n"
        "results keep the folder structure of their sources. A folder gives all motion files in it, except\n"
        "hidden ones. Many files are converted by several processes: one that crashes or hangs loses only\n"
        "its own file. The first failure ends the run unless you pass --keep-going. Results and messages "
        "are\n"
        "the same for any number of processes. The run ends with a summary; --verbose prints each result.\n\n"
        "--align first re-expresses the source relative to a T-pose, like 'gaitwright align'. Every mapped\n"
        "bone then points as in the source. Only the names in the profile are used, because its rotations\n"
        "and axes were made for the source's own rest pose.\n"
        "--check measures each result and lists its worst frames; if it is far off, also what --align\n"
        "--faithful would give. --html PAGE writes the same as a page for a browser; with several sources,\n"
        "it begins with a table, worst result first.",
        "gaitwright convert walk.bvh -o walk.Kinetra --profile \"Poser BVH\""),
    Row("batch", "FOLDER", kBatchOptions, kJob, RunBatchFolder,
        "Convert every .bvh in a folder to an .htr next to it, or package every .htr.\n"
        "Packages are written as .orn files. Existing files are replaced, and the first failure ends the "
        "run.\n"
        "--out-dir also converts subfolders and writes the results to the same tree there.",
        "gaitwright batch takes --job htr --profile \"Poser BVH\""),
    Row("plan", "SOURCE...", kPlanOptions, kOutput | kShards, RunPlan,
        "Divide a run over many files into shards, for several machines or tasks.\n"
        "Shards are about the same amount of work. Without --out-dir, results go next to their sources.\n"
        "Relative paths start at the folder where 'gaitwright run' is started. A run continues when a "
        "source\n"
        "fails.",
        "gaitwright plan archive --shards 8 -o plan.jsonl --out-dir results"),
    Row("run", "PLAN", kForce | kJobs | kReport | kTimeLimit | kVerbose | kShard, kShard, RunShard,
        "Convert one shard of a plan; run it again to finish what is left.\n"
        "By default, the report is written next to the plan: plan.shard-3.jsonl.",
        "gaitwright run plan.jsonl --shard 3"),
    Row("merge-report", "PLAN [REPORT...]", kOutput | kForce | kVerbose | kHtml, 0, RunMergeReport,
        "Merge the reports of all shards; print the summary and return the exit code of a single run.\n"
        "Lines are in the order of the plan. Without REPORT, the reports next to the plan are used. Without\n"
        "-o, the lines go to standard output. A source without a line is unfinished: run its shard again.\n"
        "--html writes the page of a single run; it shows details of sources that are on this machine.",
        "gaitwright merge-report plan.jsonl -o report.jsonl"),
    Row("info", "FILE", kClip | kRate | kListClips, 0, RunInfo,
        "Show what a motion or a container contains: format, frames, rate, clips, bones, objects.\n"
        "Frames and bones of a Kinetra file are those of the motion inside.",
        "gaitwright info walk.bvh"),
    Row("pose", "FILE", kFrame | kTime | kAll | kObjects | kOutput | kForce | kClip | kRate, 0, RunPose,
        "Print the local and world matrix of every node at a frame or a time, as JSON, or write all poses.\n"
        "Matrices are for row vectors and are written row by row. A frame past the end gives the last pose.\n"
        "--all writes world matrices of every frame: OUT.csv has a row per frame and bone, OUT.npy the "
        "shape\n"
        "frames x bones x 4 x 4, with the positions and the names of the bones in two more files.\n"
        "--objects prints all placed objects: bounds, points, normals, texture coordinates, cameras, lights.",
        "gaitwright pose walk.bvh --frame 30", kFrame | kTime | kAll),
    Row("transcode", "IN OUT", kFrameScale | kForce | kFormat | kClip | kRate, 0, RunTranscode,
        "Write an .htr with more or fewer frames, or any motion as .bvh or .glb.\n"
        "IN and OUT can be - for standard input and output; then --format selects the format.",
        "gaitwright transcode walk.htr slow.htr --frame-scale 2"),
    Row("align", "SOURCE", kOutput | kProfile | kForce, kOutput, RunAlign,
        "Write a motion as a .bvh with the same joints in the same places, relative to a T-pose.\n"
        "In the new zero pose the figure faces +Z, Y is up, and every limb lies along its axis. The source\n"
        "may have an A-pose, arms down, bones along X, Z up, slanted bones with rotated frames, or "
        "positions\n"
        "that repeat the offsets. If its up axis is not Y, the whole motion is rotated. The joints are\n"
        "identified by --profile, or else by the installed profile that matches best.",
        "gaitwright align walk.bvh -o walk-aligned.bvh"),
    Row("resave", "IN OUT", kForce, 0, RunResave,
        "Read a container and write it again, in the newest version.", "gaitwright resave old.orn new.orn"),
    Row("dump", "FILE", kOutput | kOutputFolder | kForce, 0, RunDump,
        "Write the contents of a container as linked pages, one per object, with a folding tree.\n"
        "Open Index.htm in a browser; other roots have Index2.htm and so on. Existing pages are replaced.\n"
        "-o writes everything to one page.",
        "gaitwright dump scene.orn --out-dir pages", kOutput | kOutputFolder),
    Row("extract", "FILE", kOutput | kForce, kOutput, RunExtract,
        "Extract the motion file from a Kinetra file.", "gaitwright extract walk.Kinetra -o walk.htr"),
    Row("package", "IN OUT", kRate | kForce, kRate, RunPackage, "Wrap a motion file into a Kinetra file.",
        "gaitwright package walk.htr walk.Kinetra --rate 30"),
    Row("doctor", "FILE...", kFix | kForce, 0, RunDoctor,
        "Report what is wrong with motion files, where, and how to fix it.\n"
        "Prints one line per fault, as FILE:LINE: CODE: MESSAGE, and one line of facts per file: rate, "
        "units,\n"
        "up axis, rest pose, how the body was found. The exit code is 1 if there is a fault.\n"
        "--fix writes a copy of one .bvh file without the faults that can be repaired without changing the\n"
        "motion. The copy is checked too, and the exit code is for the copy.",
        "gaitwright doctor walk.bvh --fix repaired.bvh"),
    Row("profiles", "[SOURCE]", 0, 0, RunProfiles,
        "List the installed profiles; with a source, show which ones fit and what the others lack.\n"
        "'convert' uses the first one. For each profile that fits, the list shows its confidence (sure,\n"
        "likely, doubtful) and any doubts. For the others, it shows the missing bones if at least half of\n"
        "the rows match; --json always shows them.",
        "gaitwright profiles walk.bvh"),
    Row("suggest", "SOURCE", kOutput | kForce, kOutput, RunSuggest,
        "Make a profile for a skeleton that no installed one fits.\n"
        "Joints are found by name, or else by the shape of the skeleton: mirrored limbs, which end is up,\n"
        "where the feet point. Every row is listed with its evidence and its confidence. Check the rows\n"
        "marked unsure before you convert many files with the profile.\n"
        "OUT must end in .prf. Convert with --profile OUT, or keep OUT in your own profile folder.",
        "gaitwright suggest strange.bvh -o strange.prf"),
    Row("compare", "SOURCE RESULT", kProfile | kAlign | kHtml | kForce, kProfile, RunCompare,
        "Measure a conversion: how far the result's bones, feet and path differ.\n"
        "Pass --align for a result of 'convert --align'; it re-aligns the source the same way.\n"
        "--html PAGE writes the measurements, with curves over time and the worst frames, as a browser page.",
        "gaitwright compare walk.bvh walk.htr --profile \"Poser BVH\""),
    Row("render", "FILE", kRenderOptions, 0, RunRender,
        "Draw a motion as a PNG picture, with its result next to it or below it; needs no display.\n"
        "A strip runs from the given frame to the end of the motion. A frame past the end is the last "
        "frame.\n"
        "The left side is green, the right side purple. --animate draws up to 30 pictures per second.",
        "gaitwright render walk.bvh -o walk.png --with walk.Kinetra --strip 8 --size 1600x600",
        kOutput | kAnimate),
};

size_t CountWords(std::string_view text)
{
    return static_cast<size_t>(std::ranges::count(text, ' ')) + 1;
}

} // namespace

size_t LeastOperands(const ShellCommand& command)
{
    const auto optional = std::ranges::count(command.operands, '[');
    return CountWords(command.operands) - static_cast<size_t>(optional);
}

size_t MostOperands(const ShellCommand& command)
{
    return command.operands.find("...") != command.operands.npos ? SIZE_MAX : CountWords(command.operands);
}

std::span<const ShellCommand> Commands()
{
    return kCommands;
}

} // namespace gw
