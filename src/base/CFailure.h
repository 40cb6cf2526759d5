#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <utility>
#include <vector>

namespace gw {

/// Why a reader or writer gave up, or what it warns about. The messages for these are written at the command
/// level.
enum class EFailure : uint8_t
{
    None,
    NotFound,       ///< the file cannot be opened or examined
    NotRegular,     ///< the path is a folder or a device
    ReadError,      ///< the file system failed while reading
    Changed,        ///< another program truncated the file while it was being read
    WriteError,     ///< the file system failed while writing: full disk, no permission
    Exists,         ///< the file must not be replaced; it may have appeared only meanwhile
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
    MissingTokens,  ///< a line with too few values; `name` is the joint or key
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
};

/// A failure or warning.
struct CFailure
{
    EFailure reason = EFailure::None;
    size_t where = 0; ///< line in a text, starting at 1, or byte in a container; 0 if unknown
    std::string name; ///< the bone, keyword, class or text concerned

    explicit operator bool() const { return reason != EFailure::None; }
};

/// The failures of one stream: the first error, and warnings.
class CFailureRecord
{
public:
    /// Records the first failure and ignores later ones. Always returns false, so that `return
    /// record.Fail(...)` works.
    bool Fail(EFailure reason, size_t where = 0, std::string name = {})
    {
        if (!m_kFailure)
            m_kFailure = {reason, where, std::move(name)};
        return false;
    }
    /// Records a warning; only the first kWarningsPerReason of each reason are kept.
    void Warn(EFailure reason, size_t where = 0, std::string name = {});
    void Clear() { *this = {}; }

    const CFailure& Failure() const { return m_kFailure; }
    const std::vector<CFailure>& Warnings() const { return m_kWarnings; }

private:
    static constexpr int kWarningsPerReason = 8;

    CFailure m_kFailure;
    std::vector<CFailure> m_kWarnings;
};

} // namespace gw
