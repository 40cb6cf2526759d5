#pragma once

#include "CByteSink.h"
#include "CFailure.h"
#include "CNode.h"
#include "CTextLines.h"

#include <functional>
#include <string>

namespace gw {

class CLineWriter;
class TKHTRStream;

/// The one door through which motions are loaded and saved, and the base class of the streams behind it. A
/// loaded motion is a tree of nodes with one track and one bone mesh each; frame f is reached at time f /
/// GetFrequency().
class CMotionFile
{
public:
    CMotionFile();
    /// Shares the other's trees and version, for a writer.
    CMotionFile(const CMotionFile& trees);
    CMotionFile& operator=(const CMotionFile&) = delete;
    virtual ~CMotionFile();

    /// Chooses a stream by the extension without regard to case, and takes its trees over on success; on
    /// failure the trees stay as they were. Another extension is true where a motion is held already, else
    /// false. Leaves the tree evaluated at time 0.
    virtual bool Load(const std::string& path);
    /// Writes an HTR file with frameScale times as many frames; false for every other extension and for
    /// failures.
    virtual bool Save(const std::string& path, float frameScale);
    /// Hands the text of that HTR file to a sink, in pieces.
    virtual bool SaveText(const CByteSink& sink, float frameScale);

    /// The end time of the first control, in frames, or 0.
    float GetLastFrame() const;
    /// The frame time in seconds of the first control, or 0.
    float GetFrequency() const;
    /// The number of key times of the first track, or 0.
    int GetKeyCount() const;
    /// What the last Load or Save failed on or warned of.
    const CFailureRecord& Record() const { return m_kRecord; }

    Ref<CNode> restRoot;   ///< the rest pose, without controls; HTR files only
    Ref<CNode> motionRoot; ///< the animated tree
    int fileVersion = 1;

protected:
    /// Maps a text file and rewinds. False for an empty path or a file that cannot be read.
    bool ReadLines(const std::string& path);
    /// Replaces a file by the lines that `append` writes, in one step. False for an empty path, for a file
    /// that cannot be written, and where `append` gives up; the old file stands then.
    bool WriteLines(const std::string& path, const std::function<bool(CLineWriter&)>& append);
    /// Hands such lines to a sink. False where it refuses any or `append` gives up.
    bool WriteLines(const CByteSink& sink, const std::function<bool(CLineWriter&)>& append);

    /// Whether the source still had all its bytes when Load was done with it.
    virtual bool IsSourceWhole() const { return lines.IsWhole(); }

    CTextLines lines; ///< the text being read
    CFailureRecord m_kRecord;

private:
    bool SaveBy(const std::function<bool(TKHTRStream&)>& save);
};

/// Switches every control under a node on or off. Switched off, a track gives its node the rest pose.
void SwitchControls(CNode& root, bool active);

} // namespace gw
