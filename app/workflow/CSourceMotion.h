#pragma once

#include "CFailureRecord.h"
#include "CMotionFile.h"
#include "COrrinStream.h"
#include "SourceTiming.h"

#include <string>

namespace gw {

/// The source of conversions: a motion file, or a container with keys.
class CSourceMotion
{
public:
    CSourceMotion();
    /// Uses the trees of a motion, which it shares.
    explicit CSourceMotion(const CMotionFile& motion) : m_kMotion(motion) {}

    /// Selects what Load reads: the clip of a file with several, and the rate, in frames per second, in place
    /// of the file's own; 0 for that.
    void Select(const std::string& clip, float rate);
    /// Makes Load ignore the pictures of containers, which conversions do not need. Then threads may load
    /// sources that link the same pictures.
    void SkipPictures() { m_ePictures = EPictures::Named; }
    /// Reads a file by its extension. Returns false if nothing in it is usable: see Record.
    bool Load(const std::string& path);

    const CFailureRecord& Record() const { return m_kRecord; }
    /// Returns the skeleton's root; null before a successful Load.
    CNode* Root() const;
    SourceTiming Timing() const;
    /// Returns whether there are frames. A container can claim to end before it begins.
    bool HasFrames() const { return m_bScene || m_kMotion.GetKeyCount() > 0; }
    /// Returns whether this is a container; otherwise it is the motion below.
    bool IsScene() const { return m_bScene; }
    const CMotionFile& Motion() const { return m_kMotion; }

private:
    float m_fRate = 0.0f;
    bool m_bScene = false;
    EPictures m_ePictures = EPictures::Read;
    COrrinStream m_kScene;
    CMotionFile m_kMotion;
    CFailureRecord m_kRecord;
};

} // namespace gw
