// The table of faults: code, severity, text, remedy, and whether a repaired copy can fix it. Codes are read
// by programs and never change.

#include "Fault.h"

#include <cstddef>

namespace gw {

namespace {

// Rows are function calls, because the formatter keeps their layout.
constexpr FaultRow Mended(EFault fault, std::string_view code, ESeverity severity, std::string_view words,
                          std::string_view remedy)
{
    return {fault, code, severity, true, words, remedy};
}

constexpr FaultRow Told(EFault fault, std::string_view code, ESeverity severity, std::string_view words,
                        std::string_view remedy)
{
    return {fault, code, severity, false, words, remedy};
}

using enum EFault;
using enum ESeverity;

constexpr FaultRow kFaults[] = {
    Told(Reader, "reader", Error, "the file cannot be read", "export the file again"),

    Told(LfsPointer, "lfs-pointer", Error, "this is a Git LFS pointer, not the motion itself",
         "fetch the file with 'git lfs pull'"),
    Told(NotText, "not-text", Error, "not plain text (binary or UTF-16)",
         "save it as plain text, or copy it again"),
    Mended(ByteOrderMark, "byte-order-mark", Warning, "a byte order mark, which breaks many programs",
           "save the file without it"),
    Mended(CarriageReturn, "carriage-return", Error,
           "a carriage return without a line feed, which does not end a line",
           "save the file with LF or CR LF line endings"),
    Mended(StrayCharacter, "stray-character", Error, "a character that is not allowed in a motion file",
           "remove it"),

    Mended(KeywordSpelling, "keyword-spelling", Error, "a keyword or channel is misspelled",
           "use the spelling of the format"),
    Mended(BraceOnLine, "brace-on-line", Error, "a brace follows other words, where readers do not expect it",
           "put the brace on a separate line"),
    Mended(BlankInName, "blank-in-name", Warning, "a name contains a space; only its first word is read",
           "replace the space with an underscore"),
    Told(SameName, "same-name", Warning, "two joints have this name; only the first can be mapped",
         "rename one of them"),
    Told(ChannelCount, "channel-count", Error, "more channels are listed than counted; the rest are not read",
         "correct the number after CHANNELS"),
    Told(UnknownChannel, "unknown-channel", Error, "unknown channel name; it is ignored in the rows",
         "use Xposition to Zposition and Xrotation to Zrotation"),
    Told(SecondRoot, "second-root", Warning, "a second ROOT; it is not read", "export one skeleton per file"),

    Mended(EmptyLineBeforeFrames, "empty-line-before-frames", Error,
           "an empty line between MOTION and the rows", "remove the empty line"),
    Mended(EmptyLineInRows, "empty-line-in-rows", Error, "an empty line between the rows of the motion",
           "remove the empty line"),
    Mended(DecimalComma, "decimal-comma", Error, "decimal commas; readers treat them as separators",
           "use decimal points"),
    Told(RateForTime, "rate-for-time", Warning, "the frame time looks like a rate, not seconds",
         "write the seconds per frame"),
    Mended(MissingRows, "missing-rows", Error, "fewer rows than the frame count says",
           "set the number after Frames to the number of rows, or copy the file again"),
    Mended(SurplusRows, "surplus-rows", Warning, "more rows than the frame count says; the rest are not read",
           "set the number after Frames to the number of rows"),
    Told(NoFrames, "no-frames", Warning, "no frames, so there is nothing to convert",
         "export the motion again"),
    Mended(ShortRow, "short-row", Error, "a row has too few values, so all rows after it are misread",
           "export the file again, or delete the row if it is the last"),
    Told(LongRow, "long-row", Error, "a row has more values than the joints have channels",
         "make sure that the hierarchy lists all joints and channels"),
    Mended(NaN, "nan", Error, "a value is not a finite number",
           "replace it with the mean of the frames before and after"),
    Told(StuckNumber, "stuck-number", Error, "a value is not a number, or is followed by extra characters",
         "correct the value, or export the file again"),

    Mended(DoubledOffset, "doubled-offset", Warning,
           "joint positions repeat the offsets, so bones are twice as long",
           "export rotations only, or subtract the offsets from the positions"),
    Mended(DoubledHipOffset, "doubled-hip-offset", Warning,
           "the hip's height is in its OFFSET and again in its channels, so the body floats",
           "keep only one of the two"),
    Mended(Spike, "spike", Warning, "the joint jumps away and straight back",
           "replace it with the pose halfway between its neighbors"),
    Told(StillRoot, "still-root", Warning, "the root does not move; the joint below it carries the motion",
         "map that joint as the hip"),
    Told(SidesSwapped, "sides-swapped", Warning, "left and right are swapped",
         "map left to right, or export without mirroring"),
    Told(WrongRate, "wrong-rate", Warning, "the steps of this walk do not match the frame rate",
         "correct the frame time"),
    Told(MixedChannels, "mixed-channels", Note, "joints use different rotation orders",
         "no action needed, but some programs support only one order"),
};

constexpr bool IsInOrder()
{
    for (size_t i = 0; i < std::size(kFaults); ++i)
    {
        if (kFaults[i].fault != static_cast<EFault>(i))
            return false;
    }
    return true;
}
static_assert(IsInOrder() && std::size(kFaults) == static_cast<size_t>(MixedChannels) + 1);

constexpr std::string_view kSeverityNames[] = {"error", "warning", "note"};

} // namespace

std::span<const FaultRow> FaultTable()
{
    return kFaults;
}

const FaultRow& RowOf(EFault fault)
{
    return kFaults[static_cast<size_t>(fault)];
}

std::string_view SeverityName(ESeverity severity)
{
    return kSeverityNames[static_cast<size_t>(severity)];
}

} // namespace gw
