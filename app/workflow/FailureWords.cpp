#include "FailureWords.h"

#include "Paths.h"
#include "Text.h"

#include <algorithm>

namespace gw {

namespace {

// What is written: the words, the name concerned in quotes, the remedy.
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

constexpr std::string_view kMendLine = "mend the line, or export the file again";
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
    Row(OutOfMemory, "out-of-memory", "this takes more memory than there is"),
    Row(UnknownFormat, "unknown-format", "no reader for this kind of file",
        "use .bvh, .htr, .cha, .chb, .orn"),
    Row(BadHeader, "bad-header", "the file does not begin as its extension says", kCopyAgain),
    Row(BadVersion, "bad-version", "this version of the format is not supported"),
    Row(Empty, "empty", "there is nothing in the file that could be used"),
    Row(MissingSection, "missing-section", "a section or keyword is missing", kCopyAgain),
    Row(UnexpectedLine, "unexpected-line", "another line stands where this keyword is expected", kMendLine),
    Row(BlankLine, "blank-line", "an empty line where this keyword must stand", "take the empty line out"),
    Row(BadNumber, "bad-number", "a number is expected here, and this is none that can be used", kMendLine),
    Row(BadCount, "bad-count", "a count is larger than the rest of the file can hold", kCopyAgain),
    Row(BadName, "bad-name", "a name is missing, holds a zero byte or is longer than 255 characters",
        "give the bone a shorter name"),
    Row(BadBrace, "bad-brace", "a brace is missing or stands where none belongs", kMendLine),
    Row(MissingTokens, "missing-tokens", "a line holds fewer values than it must", kMendLine),
    Row(TooFewRows, "too-few-rows", "there are fewer rows of values than frames",
        "set the count of frames to the rows that there are"),
    Row(NoRoot, "no-root", "the hierarchy has no ROOT, or a JOINT stands before it"),
    Row(UnknownSegment, "unknown-segment", "a section is for a bone that the hierarchy does not name"),
    Row(UnknownClass, "unknown-class", "the file holds an object of a class that is not known here"),
    Row(Truncated, "truncated", "the file ends in the middle of a record", kCopyAgain),
    Row(Cycle, "cycle", "objects in the file hold each other in a ring"),
    Row(TooDeep, "too-deep", "bones or objects are nested deeper than is supported"),
    Row(TooLarge, "too-large", "this is larger than the limit of the format or of the program"),
    Row(NoTrack, "no-track", "the scene holds no keyframes, so there is no motion in it"),
    Row(ShortRow, "short-row", "a row has too few values for its joints", "export the file again"),
    Row(StuckNumber, "stuck-number", "a number has something stuck to it; its beginning was read", kMendLine),
    Row(DoubledOffsets, "doubled-offsets", "joint positions repeat the offsets, so bones come out doubled",
        "export rotations only, or take the position channels out"),
    Row(RestPose, "rest-pose", "the rest pose is no T-pose, so limbs may come out turned",
        "set rotation offsets in the profile"),
    Row(BadScale, "bad-scale", "the skeletons could not be compared in size; the factor 1 was taken",
        "map both feet and the left thigh in the profile"),
    Row(UnknownChannel, "unknown-channel", "a channel has a name that is not known; it was passed over"),
    Row(CutName, "cut-name", "a name cannot be used as it stands and was changed"),
    Row(OpenHeader, "open-header", "no empty line closes the header, so the motion has no frames",
        "put an empty line behind the header"),
    Row(SkippedPicture, "skipped-picture",
        "a linked picture was not read: the pictures are too large together", "link smaller pictures"),
};

constexpr Words<EMisfit> kMisfits[] = {
    Row(EMisfit::NoScene, "no-scene", "there is no source or no target skeleton",
        "see that base.htr lies beside the program"),
    Row(EMisfit::NoProfile, "no-profile", "no profile is selected",
        "choose one that fits the source's bones"),
    Row(EMisfit::NoRootRow, "no-root-row", "no row of the profile drives the target's root bone", kMapHip),
    Row(EMisfit::NoRootSource, "no-root-source", "the profile keeps the target's root bone fixed", kMapHip),
    Row(EMisfit::NoBody, "no-body", "the profile tells too little of a body to align the motion by",
        "map hip, both thighs and neck or head"),
    Row(EMisfit::TurnedAtRest, "turned-at-rest", "limbs may come out turned, as their bones stand at rest",
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
