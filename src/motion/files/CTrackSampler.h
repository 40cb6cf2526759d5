#pragma once

#include "KeySpan.h"
#include "Mat4.h"
#include "Quat.h"

#include <optional>

namespace gw {

class CControl;
class CKeyframeControl;

/// Samples the local matrix that a track gives its node at successive times, without the node. Times between
/// the same two keys share the terms that do not change. Do not change the track while the sampler is in use.
class CTrackSampler
{
public:
    explicit CTrackSampler(const CKeyframeControl& track) : track_(track) {}

    /// Returns whether a control is a plain track that can be sampled here: no clips, one time axis, active,
    /// no parent mask.
    static bool CanSample(const CControl& control);

    /// Moves to a caller's time. Returns false if the pose equals that of the last call, bit for bit.
    bool MoveTo(float time);
    /// Returns the matrix that CKeyframeControl::UpdateTransform would set.
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
