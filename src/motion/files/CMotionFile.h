#pragma once

#include "CByteSink.h"
#include "CFailureRecord.h"
#include "CNode.h"
#include "CTextLines.h"
#include "HTRPose.h"
#include "ImportFacts.h"
#include "MotionNode.h"

#include <cstddef>
#include <functional>
#include <string>
#include <string_view>
#include <utility>

namespace gw {

class CLineWriter;
class TKHTRStream;

/// Loads and saves motions of all formats, and is the base class of the format streams. A loaded motion is a
/// tree of nodes with one track and one bone mesh each. Frame f is at time f / GetFrequency().
class CMotionFile
{
public:
    CMotionFile();
    /// Shares the other file's trees, and takes its version and its way of writing quarter turns, for a
    /// writer.
    CMotionFile(const CMotionFile& trees);
    CMotionFile& operator=(const CMotionFile&) = delete;
    virtual ~CMotionFile();

    /// Selects a stream by extension, ignoring case, and takes its trees on success; on failure the trees are
    /// unchanged. For any other extension, returns true if a motion is already loaded, otherwise false. The
    /// tree is left at time 0.
    virtual bool Load(const std::string& path);
    /// Sets a function that Load, Save and SaveText call from time to time with how much is done and the
    /// total, or with a total of 0 if that is unknown. It may throw to end the step: then Load leaves the
    /// trees unchanged, Save the file.
    void SetProgress(std::function<void(size_t, size_t)> progress) { progress_ = std::move(progress); }
    /// Writes an HTR file with frameScale times as many frames. Returns false for other extensions and on
    /// failure.
    virtual bool Save(const std::string& path, float frameScale);
    /// Sends the text of that HTR file to a sink, in pieces. The first one starts with `head`.
    virtual bool SaveText(const CByteSink& sink, float frameScale, std::string_view head);

    /// End time of the first control in frames, or 0.
    float GetLastFrame() const;
    /// Frame time of the first control in seconds, or 0.
    float GetFrequency() const;
    /// Number of key times of the first track, or 0.
    int GetKeyCount() const;
    /// Failure and warnings of the last Load or Save.
    const CFailureRecord& Record() const { return m_kRecord; }

    Ref<CNode> restRoot;   ///< the rest pose, without controls; HTR files only
    Ref<CNode> motionRoot; ///< the animated tree
    int fileVersion = 1;
    EQuarterTurns quarterTurns = EQuarterTurns::Flipped; ///< how Save writes them
    EBoneMeshes boneMeshes = EBoneMeshes::Drawn;         ///< how Load makes them
    ImportChoice importChoice;                           ///< for files of modeling programs
    ImportFacts imported;                                ///< filled by Load, for the same files

protected:
    /// Maps a text file and rewinds. Returns false for an empty path or a file that cannot be read.
    bool ReadLines(const std::string& path);
    /// Replaces a file atomically with the lines that `append` writes. Returns false for an empty path, if
    /// writing fails, and if `append` returns false; the old file is then unchanged.
    bool WriteLines(const std::string& path, const std::function<bool(CLineWriter&)>& append);
    /// Sends such lines to a sink. Returns false if the sink refuses any or `append` returns false.
    bool WriteLines(const CByteSink& sink, const std::function<bool(CLineWriter&)>& append);

    /// Returns false if the source was truncated during Load.
    virtual bool IsSourceWhole() const { return lines.IsWhole(); }

    void Report(size_t done, size_t total) const
    {
        if (progress_)
            progress_(done, total);
    }

    CTextLines lines; ///< the text being read
    CFailureRecord m_kRecord;

private:
    bool SaveBy(const std::function<bool(TKHTRStream&)>& save);

    std::function<void(size_t, size_t)> progress_;
};

/// Activates or deactivates every control below a node. An inactive track sets its node to the rest pose.
void SwitchControls(CNode& root, bool active);

} // namespace gw
