#include "FindingWords.h"

#include "MotionFacts.h"
#include "SystemError.h"
#include "Text.h"

#include <cstddef>
#include <cstdio>

namespace gw {

namespace {

struct Sentence
{
    EFailure reason;
    std::string_view code;
    std::string_view words;
    std::string_view remedy;
};

// Rows are function calls, because the formatter keeps their layout.
constexpr Sentence Row(EFailure reason, std::string_view code, std::string_view words,
                       std::string_view remedy = {})
{
    return {reason, code, words, remedy};
}

constexpr std::string_view kMendLine = "fix the line, or export the file again";
constexpr std::string_view kCopyAgain = "the file is cut short or damaged: copy or export it again";
constexpr std::string_view kMapHip = "map the source's hip to it";

using enum EFailure;
constexpr Sentence kSentences[] = {
    Row(None, "none", "nothing is wrong"),
    Row(NotFound, "not-found", "the file cannot be opened", "check the path and the permissions"),
    Row(NotRegular, "not-regular", "this is a folder or a device, not a file"),
    Row(ReadError, "read-error", "the file system failed while reading", "check the disk or the network"),
    Row(Changed, "changed", "the file was truncated while it was read", "try again when it is complete"),
    Row(WriteError, "write-error", "the file cannot be written", "check free space and permissions"),
    Row(Exists, "exists", "the file exists; --force replaces it"),
    Row(OutOfMemory, "out-of-memory", "there is not enough memory"),
    Row(UnknownFormat, "unknown-format", "this kind of file is not supported",
        "use .bvh, .htr, .cha, .chb, .orn, .fbx, .gltf, .glb, .vrm, .dae"),
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
        "align the motion, or set rotation offsets in the bone map"),
    Row(BadScale, "bad-scale", "the sizes of the skeletons could not be compared; the scale is 1",
        "map both feet and the left thigh in the bone map"),
    Row(UnknownChannel, "unknown-channel", "a channel has an unknown name and was ignored"),
    Row(CutName, "cut-name", "a name could not be used as it is and was changed"),
    Row(OpenHeader, "open-header", "no empty line closes the header, so the motion has no frames",
        "add an empty line after the header"),
    Row(SkippedPicture, "skipped-picture",
        "a linked picture was not read: together, the pictures are too large", "link smaller pictures"),
    Row(NoImporter, "no-importer", "reading this format needs the program gaitwright-import",
        "install the package gaitwright-import"),
    Row(ImportStopped, "import-stopped", "the program that reads this format ended before it was done",
        "the file may be damaged, or too large to be read"),
    Row(NotImported, "not-imported", "the file cannot be read",
        "export it again, or copy it again with the files that it refers to"),
    Row(NoSkeleton, "no-skeleton", "the file has no skeleton, so it contains no motion of a body",
        "export it with its skeleton"),
    Row(NoClip, "no-clip", "the file has no clip of this name", "list its clips with --list-clips"),

    // Found by examining a motion file.
    Row(LfsPointer, "lfs-pointer", "this is a Git LFS pointer, not the motion itself",
        "fetch the file with 'git lfs pull'"),
    Row(NotText, "not-text", "not plain text (binary or UTF-16)", "save it as plain text, or copy it again"),
    Row(ByteOrderMark, "byte-order-mark", "a byte order mark, which breaks many programs",
        "save the file without it"),
    Row(CarriageReturn, "carriage-return", "a carriage return without a line feed, which does not end a line",
        "save the file with LF or CR LF line endings"),
    Row(StrayCharacter, "stray-character", "a character that is not allowed in a motion file", "remove it"),
    Row(KeywordSpelling, "keyword-spelling", "a keyword or channel is misspelled",
        "use the spelling of the format"),
    Row(BraceOnLine, "brace-on-line", "a brace follows other words, where readers do not expect it",
        "put the brace on a separate line"),
    Row(BlankInName, "blank-in-name", "a name contains a space; only its first word is read",
        "replace the space with an underscore"),
    Row(SameName, "same-name", "two joints have this name; only the first can be mapped",
        "rename one of them"),
    Row(ChannelCount, "channel-count", "more channels are listed than counted; the rest are not read",
        "correct the number after CHANNELS"),
    Row(IgnoredChannel, "unknown-channel", "unknown channel name; it is ignored in the rows",
        "use Xposition to Zposition and Xrotation to Zrotation"),
    Row(SecondRoot, "second-root", "a second ROOT; it is not read", "export one skeleton per file"),
    Row(EmptyLineBeforeFrames, "empty-line-before-frames", "an empty line between MOTION and the rows",
        "remove the empty line"),
    Row(EmptyLineInRows, "empty-line-in-rows", "an empty line between the rows of the motion",
        "remove the empty line"),
    Row(DecimalComma, "decimal-comma", "decimal commas; readers treat them as separators",
        "use decimal points"),
    Row(RateForTime, "rate-for-time", "the frame time looks like a rate, not seconds",
        "write the seconds per frame"),
    Row(MissingRows, "missing-rows", "fewer rows than the frame count says",
        "set the number after Frames to the number of rows, or copy the file again"),
    Row(SurplusRows, "surplus-rows", "more rows than the frame count says; the rest are not read",
        "set the number after Frames to the number of rows"),
    Row(NoFrames, "no-frames", "no frames, so there is nothing to convert", "export the motion again"),
    Row(CutRow, "short-row", "a row has too few values, so all rows after it are misread",
        "export the file again, or delete the row if it is the last"),
    Row(LongRow, "long-row", "a row has more values than the joints have channels",
        "make sure that the hierarchy lists all joints and channels"),
    Row(NaN, "nan", "a value is not a finite number",
        "replace it with the mean of the frames before and after"),
    Row(NotNumber, "stuck-number", "a value is not a number, or is followed by extra characters",
        "correct the value, or export the file again"),
    Row(DoubledBone, "doubled-offset", "joint positions repeat the offsets, so bones are twice as long",
        "export rotations only, or subtract the offsets from the positions"),
    Row(DoubledHipOffset, "doubled-hip-offset",
        "the hip's height is in its OFFSET and again in its channels, so the body floats",
        "keep only one of the two"),
    Row(Spike, "spike", "the joint jumps away and straight back",
        "replace it with the pose halfway between its neighbors"),
    Row(StillRoot, "still-root", "the root does not move; the joint below it carries the motion",
        "map that joint as the hip"),
    Row(SidesSwapped, "sides-swapped", "left and right are swapped",
        "map left to right, or export without mirroring"),
    Row(WrongRate, "wrong-rate", "the steps of this walk do not match the frame rate",
        "correct the frame time"),
    Row(MixedChannels, "mixed-channels", "joints use different rotation orders",
        "no action needed, but some programs support only one order"),

    // Found by a conversion.
    Row(NoScene, "no-scene", "there is no source or no target skeleton",
        "make sure that base.htr is next to the program"),
    Row(NoProfile, "no-profile", "no bone map is selected", "choose one that matches the source's bones"),
    Row(BadProfile, "profile", "the bone map cannot be read"),
    Row(NoRootRow, "no-root-row", "no row of the bone map drives the target's root bone", kMapHip),
    Row(NoRootSource, "no-root-source", "the bone map keeps the target's root bone fixed", kMapHip),
    Row(NothingToConvert, "no-frames", "the motion has no frames, so there is nothing to convert"),
    Row(NoBody, "no-body", "the bone map has too few joints to align the motion",
        "map the hip, both thighs, and the neck or head"),
    Row(TurnedAtRest, "turned-at-rest", "limbs may end up rotated, because the rest poses differ",
        "align the motion, or set rotation offsets in the bone map"),
};

constexpr bool IsInOrder()
{
    for (size_t i = 0; i < std::size(kSentences); ++i)
    {
        if (kSentences[i].reason != static_cast<EFailure>(i))
            return false;
    }
    return true;
}
static_assert(IsInOrder() && std::size(kSentences) == static_cast<size_t>(TurnedAtRest) + 1);

const Sentence& SentenceOf(EFailure reason)
{
    return kSentences[static_cast<size_t>(reason)];
}

std::string InBrackets(std::string_view remedy)
{
    return remedy.empty() ? std::string() : " (" + std::string(remedy) + ')';
}

// Returns a number without trailing zeros: "29.97", "30".
std::string Short(double number)
{
    char text[32];
    std::snprintf(text, sizeof(text), "%.4g", number);
    return text;
}

std::string Counted(size_t count, const char* what)
{
    return std::to_string(count) + ' ' + what + (count == 1 ? "" : "s");
}

} // namespace

std::string_view FindingCode(const Finding& finding)
{
    return SentenceOf(finding.reason).code;
}

std::string_view FindingRemedy(const Finding& finding)
{
    return SentenceOf(finding.reason).remedy;
}

std::string_view SeverityName(ESeverity severity)
{
    constexpr std::string_view kNames[] = {"error", "warning", "note"};
    return kNames[static_cast<size_t>(severity)];
}

std::string FindingWords(const std::string& path, const Finding& finding)
{
    std::string words(SentenceOf(finding.reason).words);
    if (!finding.name.empty() && finding.name != path)
        words += ": \"" + Printable(finding.name) + '"';
    words += SystemErrorWords(finding.systemError);
    if (finding.more > 0)
        words += ", and " + std::to_string(finding.more) + " more";
    return words;
}

Notice MakeNotice(const std::string& path, const Finding& finding)
{
    const Sentence& sentence = SentenceOf(finding.reason);
    // The system's reason says more than advice that fits every reason.
    const std::string_view remedy = finding.systemError == 0 ? sentence.remedy : std::string_view();
    return {finding.severity,           path,         finding.where,
            std::string(sentence.code), finding.name, FindingWords(path, finding) + InBrackets(remedy)};
}

std::string FindingLine(const std::string& path, const Finding& finding)
{
    Notice notice = MakeNotice(path, finding);
    notice.words = notice.code + ": " + notice.words;
    return NoticeLine(notice);
}

std::string FactsLine(const MotionFacts& facts)
{
    std::string line = Counted(facts.jointCount, "joint") + ", " + Counted(facts.frameCount, "frame") +
                       " at " + Short(1.0 / facts.frameSeconds) + " per second";
    if (facts.leg > 0.0)
    {
        const std::string unit = facts.unit.empty() ? "an unknown unit" : std::string(facts.unit);
        line += ", legs of " + Short(facts.leg) + " (" + unit + ')';
    }
    if (!facts.up.empty())
        line += ", " + std::string(facts.up) + " up";
    line += ", rest pose: " + std::string(RestPoseName(facts.restPose));
    return line + ", body by: " + std::string(BodySourceName(facts.body));
}

} // namespace gw
