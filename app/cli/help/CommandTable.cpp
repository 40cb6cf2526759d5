#include "CommandTable.h"

#include <algorithm>

namespace gw {

namespace {

// Rows are calls, which the formatter leaves as they are read.
constexpr CCommand Row(std::string_view name, std::string_view operands, uint64_t options, uint64_t required,
                       EExit (*run)(const COptions&), std::string_view help, std::string_view example,
                       uint64_t choice = 0)
{
    return {name, operands, options, required, run, help, example, choice};
}

// Of a run over many files.
constexpr uint64_t kManyOptions = kJobs | kFilesFrom | kNull | kResume | kReport | kTimeLimit;

constexpr uint64_t kConvertOptions = kOutput | kOutputFolder | kProfile | kNoLegs | kAlign | kFaithful |
                                     kForce | kSkipExisting | kDryRun | kKeepGoing | kCheck | kHtml |
                                     kManyOptions;

constexpr uint64_t kBatchOptions = kJob | kProfile | kOutputFolder | kKeepGoing | kManyOptions;

// What of a conversion is decided when it is planned; the rest is said where it is run.
constexpr uint64_t kPlanOptions =
    (kConvertOptions & ~(kSkipExisting | kDryRun | kKeepGoing | kHtml | kManyOptions)) | kFilesFrom | kNull |
    kShards;

constexpr uint64_t kRenderOptions = kOutput | kFrame | kSize | kWith | kStrip | kForce | kSkipExisting;

constexpr CCommand kCommands[] = {
    Row("convert", "SOURCE...", kConvertOptions, 0, RunConvert,
        "Convert a motion to the target skeleton and save it as a Kinetra file.\n"
        "Without --profile the stock profile that fits is taken, else the installed one that fits best: all\n"
        "rows must fit, most rows win. It is told which one and how sure it is; one whose left and right,\n"
        "or whose arm and clavicle, lie wrong is only taken by its name. A prefix that the names of the\n"
        "source share (Model_, mixamorig3:) is put before those of the profile.\n"
        "OUT may end in .htr for the motion file alone. Several sources, or a folder, need --out-dir, where\n"
        "results lie as their sources lie below their folder. Many files are converted by several\n"
        "processes: one that crashes or hangs costs its own file only. Without --keep-going the first\n"
        "failure ends the run; what it leaves and says is the same for any number of processes.\n"
        "With --align the source is first told from a T-pose, as by 'gaitwright align', and every mapped\n"
        "bone points as its source does: of the profile only the names count, since its rotations and axes\n"
        "were made against the source's own rest pose.\n"
        "--check measures each result and names its worst frames; --html PAGE writes all of that as a page\n"
        "for a browser, of several sources with a table that begins with the worst.",
        "gaitwright convert walk.bvh -o walk.Kinetra --profile \"Poser BVH\""),
    Row("batch", "FOLDER", kBatchOptions, kJob, RunBatchFolder,
        "Convert every .bvh of a folder to an .htr beside it, or package every .htr.\n"
        "Packages are written as .orn. Files that exist are replaced; the first failure ends the run. With\n"
        "--out-dir the folders below are converted too, and the results lie there in the same tree.",
        "gaitwright batch takes --job htr --profile \"Poser BVH\""),
    Row("plan", "SOURCE...", kPlanOptions, kOutput | kShards, RunPlan,
        "Divide a run over many files into shards, for several machines or tasks.\n"
        "Shards are about equally much work. Without --out-dir results go beside their sources. Relative\n"
        "paths count from where 'gaitwright run' is started. A run goes on behind sources that fail.",
        "gaitwright plan archive --shards 8 -o plan.jsonl --out-dir results"),
    Row("run", "PLAN", kForce | kJobs | kReport | kTimeLimit | kShard, kShard, RunShard,
        "Convert one shard of a plan; started again, it does what is left.\n"
        "The report goes beside the plan unless told: plan.shard-3.jsonl.",
        "gaitwright run plan.jsonl --shard 3"),
    Row("merge-report", "PLAN [REPORT...]", kOutput | kForce, 0, RunMergeReport,
        "Join the reports of all shards in the order of the plan; say and answer what one run would.\n"
        "Without REPORT those beside the plan are taken. Without -o the lines go to standard output. A\n"
        "source without a line is left: run its shard again.",
        "gaitwright merge-report plan.jsonl -o report.jsonl"),
    Row("info", "FILE", 0, 0, RunInfo,
        "Show what a motion or a container holds: format, frames, rate, bones, objects.",
        "gaitwright info walk.bvh"),
    Row("pose", "FILE", kFrame | kTime | kObjects, 0, RunPose,
        "Print the local and world matrix of every node at a frame or a time, as JSON.\n"
        "Row vectors, row by row. A frame behind the end gives the pose of the end. With --objects all that\n"
        "has a place is told: bounds, points, normals, texture coordinates, cameras and lights.",
        "gaitwright pose walk.bvh --frame 30", kFrame | kTime),
    Row("transcode", "IN OUT", kFrameScale | kForce, 0, RunTranscode,
        "Write an .htr with more or fewer frames, or any motion as a .bvh.",
        "gaitwright transcode walk.htr slow.htr --frame-scale 2"),
    Row("align", "SOURCE", kOutput | kProfile | kForce, kOutput, RunAlign,
        "Write a motion as a .bvh with the same joints at the same places, told from a T-pose.\n"
        "In the zero pose the figure faces +Z with Y up and every limb along its axis, whatever the "
        "source's\n"
        "is: an A-pose, hanging arms, bones along X, Z up, slanted bones whose frames are turned, positions\n"
        "that repeat the offsets. A motion whose up axis is not Y is turned as a whole. Which joints are "
        "which\n"
        "is told by --profile, else by the installed profile that fits best.",
        "gaitwright align walk.bvh -o walk-aligned.bvh"),
    Row("resave", "IN OUT", kForce, 0, RunResave,
        "Read a container and write it again, in the newest version.", "gaitwright resave old.orn new.orn"),
    Row("dump", "FILE", kOutputFolder, kOutputFolder, RunDump,
        "Write what a container holds as linked pages, one for each object, with a folding tree.\n"
        "Open Index.htm of the folder in a browser; further roots have Index2.htm and so on. Pages that are\n"
        "there are replaced.",
        "gaitwright dump scene.orn --out-dir pages"),
    Row("extract", "FILE", kOutput | kForce, kOutput, RunExtract,
        "Take the motion file out of a Kinetra file.", "gaitwright extract walk.Kinetra -o walk.htr"),
    Row("package", "IN OUT", kRate | kForce, kRate, RunPackage, "Wrap a motion file into a Kinetra file.",
        "gaitwright package walk.htr walk.Kinetra --rate 30"),
    Row("doctor", "FILE...", kFix | kForce, 0, RunDoctor,
        "Say what is wrong with motion files, where, and what to do about it.\n"
        "A line for each fault, as FILE:LINE: CODE: WORDS, and one of facts for each file: rate, units, the\n"
        "way up, the rest pose, how the body was found. Exit code 1 where a fault was found.\n"
        "With --fix a copy of one .bvh is written with all faults gone that can be mended without changing\n"
        "the motion; it is examined in turn, and the exit code is that of the copy.",
        "gaitwright doctor walk.bvh --fix mended.bvh"),
    Row("profiles", "[SOURCE]", 0, 0, RunProfiles,
        "List the installed profiles; with a source, which fit and what the others miss.\n"
        "The first one is what 'convert' takes. Those that fit tell how sure they are (sure, likely,\n"
        "doubtful) and what speaks against them; of the others, those that fit by half tell what they\n"
        "miss, and --json tells it of all.",
        "gaitwright profiles walk.bvh"),
    Row("suggest", "SOURCE", kOutput | kForce, kOutput, RunSuggest,
        "Make a profile for a skeleton that no installed one fits.\n"
        "Joints are found by their names, else by the shape of the skeleton: mirrored limbs, which end\n"
        "is up, where the feet point. Every row is listed with what it is taken from and how sure that is;\n"
        "look at the rows that are called unsure before you convert many files with the profile.\n"
        "OUT ends in .prf. Convert with --profile OUT, or keep it with your own profiles.",
        "gaitwright suggest strange.bvh -o strange.prf"),
    Row("compare", "SOURCE RESULT", kProfile | kAlign | kHtml | kForce, kProfile, RunCompare,
        "Measure a conversion: how far the result's bones, feet and path differ.\n"
        "A result of convert --align is measured with --align, which tells the source anew as it was then.\n"
        "--html PAGE writes the figures with curves over time and the worst frames as a page for a browser.",
        "gaitwright compare walk.bvh walk.htr --profile \"Poser BVH\""),
    Row("render", "FILE", kRenderOptions, kOutput, RunRender,
        "Draw a motion into a PNG picture, with its result beside it or under it; needs no display.\n"
        "A strip begins at the frame and goes to the end of the motion. A frame behind the end is the end.",
        "gaitwright render walk.bvh -o walk.png --with walk.Kinetra --strip 8 --size 1600x600"),
};

size_t CountWords(std::string_view text)
{
    return static_cast<size_t>(std::ranges::count(text, ' ')) + 1;
}

} // namespace

size_t LeastOperands(const CCommand& command)
{
    const auto optional = std::ranges::count(command.operands, '[');
    return CountWords(command.operands) - static_cast<size_t>(optional);
}

size_t MostOperands(const CCommand& command)
{
    return command.operands.find("...") != command.operands.npos ? SIZE_MAX : CountWords(command.operands);
}

std::span<const CCommand> Commands()
{
    return kCommands;
}

} // namespace gw
