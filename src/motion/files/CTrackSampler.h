#pragma once

#include "KeySpan.h"
#include "Mat4.h"
#include "Quat.h"

#include <optional>

namespace gw {

class CControl;
class CKeyframeControl;

/// Reads the local matrix that a track gives its node at one time after another, without the node. Times
/// between the same two keys share what does not change from one to the next. The track must stay as it is
/// meanwhile.
class CTrackSampler
{
public:
    explicit CTrackSampler(const CKeyframeControl& track) : track_(track) {}

    /// Whether a control is a plain track that can be read here: no clips, one time axis, active, no parent
    /// mask.
    static bool CanSample(const CControl& control);

    /// Goes to a caller's time. False if the pose is that of the last call, bit for bit.
    bool MoveTo(float time);
    /// The matrix that CKeyframeControl::UpdateTransform would write there.
    Mat4 Local() const;

private:
    struct Pose
    {
        Quat rotation = kQuatIdentity;
        Vec3 position = kVec3Zero;
        Vec3 scale = kVec3One;
    };

    Quat RotationAt(const KeySpan& span);

    const CKeyframeControl& track_;
    KeyCursor m_uiCursor = 0;
    std::optional<CQuatArc> arc_; // between keys m_uiArc and m_uiArcEnd
    uint32_t m_uiArc = 0;
    uint32_t m_uiArcEnd = 0;
    Pose m_kPose;
    bool m_bHasPose = false;
};

} // namespace gw
