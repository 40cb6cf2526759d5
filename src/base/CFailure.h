#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <utility>
#include <vector>

namespace gw {

/// Why a reader or writer gave up, or what it did not like. Words for these stand at the command level only.
enum class EFailure : uint8_t
{
    None,
    NotFound,       ///< the file cannot be opened or examined
    NotRegular,     ///< the path is a folder or a device
    ReadError,      ///< the file system failed while reading
    Changed,        ///< another program cut the file short while it was read
    WriteError,     ///< the file system failed while writing: full disk, no permission
    Exists,         ///< a file that may not be replaced, perhaps since it appeared meanwhile
    OutOfMemory,    ///< more memory than can be had
    UnknownFormat,  ///< no reader for this extension
    BadHeader,      ///< the file does not begin as it must
    BadVersion,     ///< a version that is not supported
    Empty,          ///< nothing in the file that could be used
    MissingSection, ///< a section or keyword never comes; `name` says which
    UnexpectedLine, ///< another line stands where a keyword must stand; `name` is the keyword
    BlankLine,      ///< an empty line where none may stand
    BadNumber,      ///< no number, or one that is not finite; `name` is the text
    BadCount,       ///< a count that the rest of the file cannot hold
    BadName,        ///< a name that is too long or missing
    BadBrace,       ///< a brace too many or too few
    MissingTokens,  ///< a line with fewer values than it must have; `name` is the joint or key
    TooFewRows,     ///< fewer rows than frames
    NoRoot,         ///< a joint before any root, or no root at all
    UnknownSegment, ///< a section for a bone that the hierarchy does not name
    UnknownClass,   ///< an object of a class that cannot be made
    Truncated,      ///< the file ends inside a record
    Cycle,          ///< objects hold each other in a ring
    TooDeep,        ///< nested deeper than the limit
    TooLarge,       ///< what would take more than the limit
    NoTrack,        ///< a scene without keyframes
    // Things that are read all the same.
    ShortRow,       ///< a row with too few values for its joints
    StuckNumber,    ///< a number with something stuck to it
    DoubledOffsets, ///< joint positions that repeat the offsets, so that bones come out doubled
    RestPose,       ///< a rest pose that is no T-pose
    BadScale,       ///< the body measures give no usable scale; 1.0 was taken
    UnknownChannel, ///< a channel name that is not one of the nine
    CutName,        ///< a name that was not usable as it stands
    OpenHeader,     ///< a header that nothing closes, so that the motion behind it has no frame
    SkippedPicture, ///< a linked picture that was not decoded, because the scene's pictures take too much
                    ///< memory
};

/// One thing that failed or that a user should know.
struct CFailure
{
    EFailure reason = EFailure::None;
    size_t where = 0; ///< line from 1 on in a text, byte in a container; 0 where there is none
    std::string name; ///< bone, keyword, class or text concerned

    explicit operator bool() const { return reason != EFailure::None; }
};

/// What a stream keeps beside its answers: the first failure, and warnings.
class CFailureRecord
{
public:
    /// Keeps the first failure only. Always answers false, so that `return record.Fail(...)` reads well.
    bool Fail(EFailure reason, size_t where = 0, std::string name = {})
    {
        if (!m_kFailure)
            m_kFailure = {reason, where, std::move(name)};
        return false;
    }
    /// Keeps a warning; of each reason the first kWarningsPerReason.
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
