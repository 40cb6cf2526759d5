#include "CTrackSampler.h"

#include "CKeyframeControl.h"

#include <cstring>
#include <typeinfo>

namespace gw {

bool CTrackSampler::CanSample(const CControl& control)
{
    if (typeid(control) != typeid(CKeyframeControl) || !control.m_bActive)
        return false;
    const auto& track = static_cast<const CKeyframeControl&>(control);
    return !track.m_kKeyTimes.empty() && track.m_uiParentMask == 0;
}

Quat CTrackSampler::RotationAt(const KeySpan& span)
{
    const std::vector<Quat>& keys = track_.m_kRotationKeys;
    if (keys.empty())
        return kQuatIdentity;
    if (span.fraction == 0.0f)
        return KeyAt(keys, span.a);
    if (!arc_ || m_uiArc != span.a || m_uiArcEnd != span.b)
    {
        arc_.emplace(KeyAt(keys, span.a), KeyAt(keys, span.b));
        m_uiArc = span.a;
        m_uiArcEnd = span.b;
    }
    return arc_->At(span.fraction);
}

bool CTrackSampler::MoveTo(float time)
{
    const KeySpan span = FindKeys(track_.MapTime(time), track_.m_kKeyTimes, m_uiCursor);
    const Pose pose{RotationAt(span), LinearKey(track_.m_kPositionKeys, span, kVec3Zero),
                    LinearKey(track_.m_kScaleKeys, span, kVec3One)};
    // NOLINTNEXTLINE(bugprone-suspicious-memory-comparison): as keys are compared, without gaps
    if (m_bHasPose && std::memcmp(&pose, &m_kPose, sizeof(Pose)) == 0)
        return false;
    m_kPose = pose;
    m_bHasPose = true;
    return true;
}

Mat4 CTrackSampler::Local() const
{
    return Mat4Compose(QuatToMat3(m_kPose.rotation), kVec3Zero + m_kPose.position, m_kPose.scale);
}

} // namespace gw
