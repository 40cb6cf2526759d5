// The table of failures and warnings: a code for programs, a sentence for people, and a remedy.

#include "FailureWords.h"

#include "Paths.h"
#include "Text.h"

#include <algorithm>

namespace gw {

namespace {

// A message consists of the sentence, the name concerned in quotes, and the remedy.
template <class Reason>
struct Words
{
    Reason m_eReason;
    std::string_view m_kCode;
    std::string_view m_kWords;
    std::string_view m_kRemedy;
};

template <class Reason>
constexpr Words<Reason> Row(Reason reason, std::string_view code, std::string_view words,
                            std::string_view remedy = {})
{
    return {reason, code, words, remedy};
}

constexpr std::string_view kMendLine = "fix the line, or export the file again";
constexpr std::string_view kCopyAgain = "the file is cut short or damaged: copy or export it again";
constexpr std::string_view kMapHip = "map the source's hip to it";

using enum EFailure;
constexpr Words<EFailure> kFailures[] = {
    Row(None, "none", "nothing is wrong"),
    Row(NotFound, "not-found", "the file cannot be opened", "check the path and the permissions"),
    Row(NotRegular, "not-regular", "this is a folder or a device, not a file"),
    Row(ReadError, "read-error", "the file system failed while reading", "check the disk or the network"),
    Row(Changed, "changed", "the file was truncated while it was read", "try again when it is complete"),
    Row(Exists, "exists", "the file exists; --force replaces it"),
    Row(WriteError, "write-error", "the file cannot be written", "check free space and permissions"),
    Row(OutOfMemory, "out-of-memory", "there is not enough memory"),
    Row(UnknownFormat, "unknown-format", "this kind of file is not supported",
        "use .bvh, .htr, .cha, .chb, .orn"),
    Row(BadHeader, "bad-header", "the beginning of the file does not match its extension", kCopyAgain),
    Row(BadVersion, "bad-version", "this version of the format is not supported"),
    Row(Empty, "empty", "the file contains nothing usable"),
    Row(MissingSection, "missing-section", "a section or keyword is missing", kCopyAgain),
    Row(UnexpectedLine, "unexpected-line", "expected this keyword, but found another line", kMendLine),
    Row(BlankLine, "blank-line", "expected this keyword, but found an empty line", "remove the empty line"),
    Row(BadNumber, "bad-number", "expected a number, but this is not a usable number", kMendLine),
    Row(BadCount, "bad-count", "a count is larger than the rest of the file allows", kCopyAgain),
    Row(BadName, "bad-name", "a name is missing, contains a zero byte, or is longer than 255 characters",
        "give the bone a shorter name"),
    Row(BadBrace, "bad-brace", "a brace is missing or misplaced", kMendLine),
    Row(MissingTokens, "missing-tokens", "a line has too few values", kMendLine),
    Row(TooFewRows, "too-few-rows", "there are fewer rows of values than frames",
        "set the frame count to the number of rows"),
    Row(NoRoot, "no-root", "the hierarchy has no ROOT, or a JOINT comes before it"),
    Row(UnknownSegment, "unknown-segment", "a section belongs to a bone that is not in the hierarchy"),
    Row(UnknownClass, "unknown-class", "the file contains an object of an unknown class"),
    Row(Truncated, "truncated", "the file ends in the middle of a record", kCopyAgain),
    Row(Cycle, "cycle", "objects in the file refer to each other in a cycle"),
    Row(TooDeep, "too-deep", "bones or objects are nested too deeply"),
    Row(TooLarge, "too-large", "this exceeds a limit of the format or of the program"),
    Row(NoTrack, "no-track", "the scene has no keyframes, so it contains no motion"),
    Row(ShortRow, "short-row", "a row has fewer values than its joints need", "export the file again"),
    Row(StuckNumber, "stuck-number", "a number is followed by extra characters; they were ignored",
        kMendLine),
    Row(DoubledOffsets, "doubled-offsets", "joint positions repeat the offsets, so bones are twice as long",
        "export rotations only, or remove the position channels"),
    Row(RestPose, "rest-pose", "the rest pose is not a T-pose, so limbs may end up rotated",
        "set rotation offsets in the profile"),
    Row(BadScale, "bad-scale", "the sizes of the skeletons could not be compared; the scale is 1",
        "map both feet and the left thigh in the profile"),
    Row(UnknownChannel, "unknown-channel", "a channel has an unknown name and was ignored"),
    Row(CutName, "cut-name", "a name could not be used as it is and was changed"),
    Row(OpenHeader, "open-header", "no empty line closes the header, so the motion has no frames",
        "add an empty line after the header"),
    Row(SkippedPicture, "skipped-picture",
        "a linked picture was not read: together, the pictures are too large", "link smaller pictures"),
};

constexpr Words<EMisfit> kMisfits[] = {
    Row(EMisfit::NoScene, "no-scene", "there is no source or no target skeleton",
        "make sure that base.htr is next to the program"),
    Row(EMisfit::NoProfile, "no-profile", "no profile is selected",
        "choose one that matches the source's bones"),
    Row(EMisfit::BadProfile, "profile", "the profile cannot be read"),
    Row(EMisfit::NoRootRow, "no-root-row", "no row of the profile drives the target's root bone", kMapHip),
    Row(EMisfit::NoRootSource, "no-root-source", "the profile keeps the target's root bone fixed", kMapHip),
    Row(EMisfit::NoFrames, "no-frames", "the motion has no frames, so there is nothing to convert"),
    Row(EMisfit::NoBody, "no-body", "the profile maps too few joints to align the motion",
        "map the hip, both thighs, and the neck or head"),
    Row(EMisfit::TurnedAtRest, "turned-at-rest", "limbs may end up rotated, because the rest poses differ",
        "align the motion, or set rotation offsets in the profile"),
};

template <class Reason, size_t count>
const Words<Reason>& RowOf(const Words<Reason> (&table)[count], Reason reason)
{
    const auto* found = std::ranges::find(table, reason, &Words<Reason>::m_eReason);
    return found == std::end(table) ? table[0] : *found;
}

template <class Reason>
CReport ReportOf(const Words<Reason>& row, const std::string& path, const std::string& name)
{
    CReport report;
    report.path = path;
    report.code = row.m_kCode;
    report.name = name;
    report.words = row.m_kWords;
    if (!name.empty() && name != path)
        report.words += ": \"" + Printable(name) + '"';
    if (!row.m_kRemedy.empty())
        report.words += " (" + std::string(row.m_kRemedy) + ')';
    return report;
}

bool IsBinary(const std::string& path)
{
    constexpr std::string_view kExtensions[] = {".orn", ".kinetra", ".chb"};
    return std::ranges::any_of(kExtensions, [&](std::string_view e) { return HasExtension(path, e); });
}

} // namespace

std::string_view FailureCode(EFailure reason)
{
    return RowOf(kFailures, reason).m_kCode;
}

std::string_view FailureRemedy(EFailure reason)
{
    return RowOf(kFailures, reason).m_kRemedy;
}

CReport MakeReport(const std::string& path, const CFailure& failure, bool warning)
{
    CReport report = ReportOf(RowOf(kFailures, failure.reason), path, failure.name);
    report.where = failure.where;
    report.warning = warning;
    return report;
}

CReport MakeReport(const std::string& path, EMisfit misfit, const std::string& name)
{
    return ReportOf(RowOf(kMisfits, misfit), path, name);
}

std::string ReportLine(const CReport& report)
{
    std::string line = Printable(report.path);
    if (report.where != 0)
        line += (IsBinary(report.path) ? ": byte " : ":") + std::to_string(report.where);
    return (line.empty() ? line : line + ": ") + report.words;
}

} // namespace gw
