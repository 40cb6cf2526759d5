#pragma once

#include "CKeyArray.h"
#include "Quat.h"
#include "Vec3.h"

#include <cstddef>
#include <cstdint>
#include <vector>

namespace gw {

class CKeyframeControl;
class CMotionFile;
class CNode;

/// Changes to a finished result. None of them needs the source.
struct MotionEdits
{
    int64_t firstFrame = 0;
    int64_t lastFrame = INT64_MAX; ///< included; one past the end is the end
    bool inPlace = false; ///< every frame has the first frame's horizontal position; heights are kept
    bool mirror = false;  ///< reflects the motion at the plane between left and right

    bool IsAny() const { return firstFrame > 0 || lastFrame != INT64_MAX || inPlace || mirror; }
};

/// Sets the frame time of all tracks below a node, in seconds. Keys are at frames, so the poses do not
/// change.
void SetFrameTime(CNode& root, float seconds);

/// A result while it is edited, for writing. The motion is as before when the object is gone. Frames must be
/// in the range of the motion.
class CEditedMotion
{
public:
    /// The motion must be one of the host skeleton, and outlive the object.
    CEditedMotion(const CMotionFile& motion, const MotionEdits& edits);
    ~CEditedMotion();
    CEditedMotion(const CEditedMotion&) = delete;
    CEditedMotion& operator=(const CEditedMotion&) = delete;

private:
    /// A track and its keys before the changes.
    struct Track
    {
        CKeyframeControl* control;
        std::vector<Quat> rotations;
        CKeyArray<Vec3> positions;
        CKeyArray<Vec3> scales;
        std::vector<float> times;
        float endTime;
    };

    std::vector<Track> m_kTracks;
};

} // namespace gw
