#include "Fault.h"

#include <cstddef>

namespace gw {

namespace {

// Rows are calls, which the formatter leaves as they are read.
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
    Told(Reader, "reader", Error, "the reader does not take it", "export the file again"),

    Told(LfsPointer, "lfs-pointer", Error,
         "this is a pointer of Git LFS to the motion, and not the motion itself",
         "fetch the file with 'git lfs pull'"),
    Told(NotText, "not-text", Error, "these bytes are no text, or one of 16 bits a character",
         "save it as plain text, or copy it again"),
    Mended(ByteOrderMark, "byte-order-mark", Warning, "a byte order mark, which many programs trip over",
           "save it without one"),
    Mended(CarriageReturn, "carriage-return", Error,
           "a carriage return without a line feed, which ends no line",
           "save it with line ends of LF or CR LF"),
    Mended(StrayCharacter, "stray-character", Error, "a character that belongs into no motion file",
           "take it out"),

    Mended(KeywordSpelling, "keyword-spelling", Error, "a keyword or channel is not spelled as readers want",
           "spell it as the format does"),
    Mended(BraceOnLine, "brace-on-line", Error, "a brace stands behind other words, where none is looked for",
           "give the brace a line of its own"),
    Mended(BlankInName, "blank-in-name", Warning, "a name with a blank in it; only its first word is read",
           "put an underscore in place of the blank"),
    Told(SameName, "same-name", Warning, "two joints have this name; only the first can be mapped",
         "rename one of them"),
    Told(ChannelCount, "channel-count", Error, "more channels are named than counted; the rest is not read",
         "correct the number behind CHANNELS"),
    Told(UnknownChannel, "unknown-channel", Error, "no channel has this name; rows are read without it",
         "use Xposition to Zposition and Xrotation to Zrotation"),
    Told(SecondRoot, "second-root", Warning, "a second ROOT; nothing of it is read",
         "export one skeleton a file"),

    Mended(EmptyLineBeforeFrames, "empty-line-before-frames", Error,
           "an empty line between MOTION and the rows", "take the empty line out"),
    Mended(EmptyLineInRows, "empty-line-in-rows", Error, "an empty line between the rows of the motion",
           "take the empty line out"),
    Mended(DecimalComma, "decimal-comma", Error, "decimal commas; readers take them for separators",
           "write numbers with points"),
    Told(RateForTime, "rate-for-time", Warning, "a frame lasts this many seconds; a rate was written for it",
         "write the seconds from frame to frame"),
    Mended(MissingRows, "missing-rows", Error, "fewer rows than frames are promised",
           "set the number behind Frames to the rows that there are, or copy the file again"),
    Mended(SurplusRows, "surplus-rows", Warning, "more rows than frames are promised; the rest is not read",
           "set the number behind Frames to the rows that there are"),
    Told(NoFrames, "no-frames", Warning, "no frames, so there is nothing to convert",
         "export the motion again"),
    Mended(ShortRow, "short-row", Error,
           "a row has too few values for its joints; all that follow are read out of step",
           "export the file again, or drop the row where it is the last"),
    Told(LongRow, "long-row", Error, "a row has more values than the joints have channels",
         "see that the hierarchy names all joints and channels"),
    Mended(NaN, "nan", Error, "a value that is no finite number",
           "put the mean of the frames before and after in its place"),
    Told(StuckNumber, "stuck-number", Error, "a value that is no number, or has something stuck to it",
         "correct the value, or export the file again"),

    Mended(DoubledOffset, "doubled-offset", Warning,
           "joint positions repeat the offsets, so that bones come out doubled",
           "export rotations only, or take the offset off the positions"),
    Mended(DoubledHipOffset, "doubled-hip-offset", Warning,
           "the hip's height stands in its OFFSET and in its channels, so that the body floats",
           "leave it in one of the two"),
    Mended(Spike, "spike", Warning, "the joint jumps out and back at once",
           "put the pose between the frames before and after in its place"),
    Told(StillRoot, "still-root", Warning, "the root stands still; the joint below it carries the motion",
         "map that joint as the hip"),
    Told(SidesSwapped, "sides-swapped", Warning, "left and right are swapped, as the body stands",
         "map left to right, or export without mirroring"),
    Told(WrongRate, "wrong-rate", Warning, "the steps of this gait do not go with the rate",
         "correct the frame time"),
    Told(MixedChannels, "mixed-channels", Note, "the rotations of joints stand in different orders",
         "nothing is to be done here; some programs read one order only"),
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
