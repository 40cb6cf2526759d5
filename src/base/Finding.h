#pragma once

#include <cstddef>
#include <cstdint>
#include <string>

namespace gw {

/// What can be wrong with a file or a conversion. The sentences for these are only in
/// app/workflow/FindingWords.
enum class EFailure : uint8_t
{
    None,
    NotFound,       ///< the file cannot be opened or examined
    NotRegular,     ///< the path is a folder or a device
    ReadError,      ///< the file system failed while reading
    Changed,        ///< another program truncated the file while it was being read
    WriteError,     ///< the file system failed while writing: full disk, no permission
    Exists,         ///< an existing file must not be replaced; it may have appeared in the meantime
    OutOfMemory,    ///< not enough memory
    UnknownFormat,  ///< no reader for this extension
    BadHeader,      ///< the file does not begin as required
    BadVersion,     ///< a version that is not supported
    Empty,          ///< nothing usable in the file
    MissingSection, ///< a section or keyword is missing; `name` is the keyword
    UnexpectedLine, ///< another line where a keyword is required; `name` is the keyword
    BlankLine,      ///< an empty line where it is not allowed
    BadNumber,      ///< not a number, or not finite; `name` is the text
    BadCount,       ///< a count larger than the rest of the file can hold
    BadName,        ///< a name that is missing or too long
    BadBrace,       ///< unbalanced braces
    MissingTokens,  ///< a line with too few values; `name` is the joint or the key
    TooFewRows,     ///< fewer rows than frames
    NoRoot,         ///< no root, or a joint before it
    UnknownSegment, ///< a section for a bone that is not in the hierarchy
    UnknownClass,   ///< an object of an unknown or abstract class
    Truncated,      ///< the file ends inside a record
    Cycle,          ///< objects that hold each other in a cycle
    TooDeep,        ///< nested deeper than the limit
    TooLarge,       ///< larger than the limit
    NoTrack,        ///< a scene without keyframes
    // Warnings: the file is read anyway.
    ShortRow,       ///< a row with too few values for its joints
    StuckNumber,    ///< a number followed directly by other characters
    DoubledOffsets, ///< joint positions that repeat the offsets, which doubles the bones
    RestPose,       ///< the rest pose is not a T-pose
    BadScale,       ///< the body measures yield no usable scale; 1.0 was used
    UnknownChannel, ///< a channel name that is not one of the nine
    CutName,        ///< a name that had to be changed to be usable
    OpenHeader,     ///< an unclosed header, so the motion after it has no frames
    /// a linked picture that was not decoded, because the scene's pictures take too much memory
    SkippedPicture,

    // Files of modeling programs, which another program reads.
    NoImporter,    ///< that program is not installed
    ImportStopped, ///< it died or was killed
    NotImported,   ///< it cannot read the file; `name` is the reason
    NoSkeleton,    ///< no joints
    NoClip,        ///< no clip of this name

    // Found by examining a motion file. Readers and writers do not use the reasons from here on.
    LfsPointer,
    NotText,
    ByteOrderMark,
    CarriageReturn,
    StrayCharacter,
    KeywordSpelling,
    BraceOnLine,
    BlankInName,
    SameName,
    ChannelCount,   ///< more channels listed than counted
    IgnoredChannel, ///< an unknown channel, like UnknownChannel
    SecondRoot,
    EmptyLineBeforeFrames,
    EmptyLineInRows,
    DecimalComma,
    RateForTime, ///< the frame time looks like a frame rate
    MissingRows,
    SurplusRows,
    NoFrames,
    CutRow,  ///< a row with too few values, so that readers misread all rows after it
    LongRow, ///< a row with more values than there are channels
    NaN,
    NotNumber,        ///< a value that is not a number, or is followed by something else
    DoubledBone,      ///< positions repeat the offset, like DoubledOffsets
    DoubledHipOffset, ///< the hip's height is in its offset and also in its channels
    Spike,
    StillRoot, ///< the joint below the root carries the root's motion
    SidesSwapped,
    WrongRate, ///< the steps of the walk do not match the frame rate
    MixedChannels,

    // Found by a conversion: the motion was read but cannot be converted, or not well.
    NoScene,          ///< no source is open, or base.htr could not be read
    NoProfile,        ///< no profile is selected
    BadProfile,       ///< the profile's file cannot be read
    NoRootRow,        ///< no row drives the target's root bone
    NoRootSource,     ///< the row of the target's root bone is fixed
    NothingToConvert, ///< the source has no frames
    NoBody,           ///< the rows drive too little of a body to align it
    TurnedAtRest,     ///< rows rotate limbs in the source's rest pose; `name` is one of its joints
};

enum class ESeverity : uint8_t
{
    Error,   ///< refused, or read differently than intended
    Warning, ///< read, but the effect is visible in a conversion
    Note,    ///< valid, but good to know
};

/// One finding: why something failed, or what the user should know although it succeeded.
struct Finding
{
    EFailure reason = EFailure::None;
    size_t where = 0;      ///< line of a text, starting at 1, or byte of a container; 0 if unknown
    std::string name = {}; ///< bone, keyword, class or text concerned; may be empty
    ESeverity severity = ESeverity::Error;
    bool mendable = false; ///< can be fixed in a repaired copy
    size_t more = 0;       ///< further findings like this one, which are only counted
    int systemError = 0;   ///< errno of the system call that failed, or 0

    explicit operator bool() const { return reason != EFailure::None; }
};

/// Returns whether a failed system call may be the cause of a failure.
constexpr bool IsOfSystem(EFailure reason)
{
    return reason == EFailure::NotFound || reason == EFailure::ReadError || reason == EFailure::WriteError;
}

/// Returns whether a reason is used by readers and writers, not by an examination or a conversion.
constexpr bool IsOfReader(EFailure reason)
{
    return reason < EFailure::LfsPointer;
}

} // namespace gw
