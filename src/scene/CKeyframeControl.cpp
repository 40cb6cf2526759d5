// Keyframe interpolation. The tracks are sampled separately: linear for positions and scales, spherical for
// rotations. Each track remembers where the last search ended, because playback asks for ascending times. The
// target's local matrix becomes S · R of the samples; the parent's pose is undone if the mask asks for it,
// and the position is added last.

#include "CKeyframeControl.h"

#include "CFieldArchive.h"
#include "CSpatial.h"

namespace gw {

const CRTTI CKeyframeControl::ms_kRTTI{"CKeyframeControl", &CControl::ms_kRTTI};

namespace {

Mat3 RotationKey(const std::vector<Quat>& keys, const KeySpan& span)
{
    if (keys.empty())
        return kMat3Identity;
    const Quat& a = KeyAt(keys, span.a);
    return QuatToMat3(span.fraction == 0.0f ? a : QuatSlerp(span.fraction, a, KeyAt(keys, span.b)));
}

} // namespace

CKeyframeControl::CKeyframeControl() = default;
CKeyframeControl::CKeyframeControl(const CKeyframeControl& source) = default;
CKeyframeControl::~CKeyframeControl() = default;

CObject* CKeyframeControl::CreateClone() const
{
    return new CKeyframeControl(*this);
}

void CKeyframeControl::Fields(CFieldArchive& archive)
{
    CControl::Fields(archive);
    archive.Matrix("m_kRestMatrix", m_kRestMatrix);
    archive.Bool("m_bHasRestMatrix", m_bHasRestMatrix);
    archive.Block("m_kRotationKeys", m_kRotationKeys);
    archive.Block("m_kPositionKeys", m_kPositionKeys);
    archive.Block("m_kScaleKeys", m_kScaleKeys);
    archive.Block("m_kKeyTimes", m_kKeyTimes);
    archive.Block("m_kRotationTimes", m_kRotationTimes);
    archive.Block("m_kPositionTimes", m_kPositionTimes);
    archive.Block("m_kScaleTimes", m_kScaleTimes);
    archive.Unsigned("m_uiParentMask", m_uiParentMask);
}

uint64_t CKeyframeControl::GetMemoryUsed() const
{
    const size_t times =
        m_kKeyTimes.size() + m_kRotationTimes.size() + m_kPositionTimes.size() + m_kScaleTimes.size();
    return CControl::GetMemoryUsed() + 200 + m_kRotationKeys.size() * sizeof(Quat) +
           (m_kPositionKeys.size() + m_kScaleKeys.size()) * sizeof(Vec3) + times * sizeof(float);
}

bool CKeyframeControl::Update(float)
{
    return false;
}

void CKeyframeControl::GetPose(float time, Mat3& rotation, Vec3& position, Vec3& scale)
{
    const float keyTime = MapTime(time);
    if (!m_kKeyTimes.empty())
    {
        const KeySpan span = FindKeys(keyTime, m_kKeyTimes, m_uiKeyCursor);
        rotation = RotationKey(m_kRotationKeys, span);
        position = LinearKey(m_kPositionKeys, span, kVec3Zero);
        scale = LinearKey(m_kScaleKeys, span, kVec3One);
        return;
    }
    rotation = kMat3Identity;
    position = kVec3Zero;
    scale = kVec3One;
    if (!m_kRotationTimes.empty())
        rotation = RotationKey(m_kRotationKeys, FindKeys(keyTime, m_kRotationTimes, m_uiRotationCursor));
    if (!m_kPositionTimes.empty())
        position =
            LinearKey(m_kPositionKeys, FindKeys(keyTime, m_kPositionTimes, m_uiPositionCursor), kVec3Zero);
    if (!m_kScaleTimes.empty())
        scale = LinearKey(m_kScaleKeys, FindKeys(keyTime, m_kScaleTimes, m_uiScaleCursor), kVec3One);
}

bool CKeyframeControl::UpdateTransform(float time)
{
    CSpatial* target = RecordCast<CSpatial>(GetTarget());
    if (!target || (!m_bActive && !m_bHasRestMatrix))
        return false;
    ++target->m_uiChangeStamp;
    if (!m_bActive)
    {
        target->m_kMatrix = m_kRestMatrix;
        return true;
    }
    Mat3 rotation;
    Vec3 position;
    Vec3 scale;
    GetPose(time, rotation, position, scale);
    target->m_kMatrix = Mat4Compose(rotation, kVec3Zero, scale);
    if (m_uiParentMask != 0)
        CancelParent(*target, time);
    target->m_kMatrix.SetTranslation(target->m_kMatrix.Translation() + position);
    return true;
}

// Undoes the selected components of the pose that the parent's first track has at this time, computed from
// its keys alone.
void CKeyframeControl::CancelParent(CSpatial& target, float time)
{
    CSpatial* parent = target.GetParent();
    if (!parent || !parent->GetControl())
        return;
    CObject* found = parent->GetControl()->FindObject(nullptr, &CKeyframeControl::ms_kRTTI, true);
    if (!found)
        return;
    Mat3 rotation;
    Vec3 position;
    Vec3 scale;
    static_cast<CKeyframeControl*>(found)->GetPose(time, rotation, position, scale);
    Quat q = QuatFromMat3(rotation);

    float* const components[] = {&position.x, &position.y, &position.z, &q.x,    &q.y,
                                 &q.z,        &scale.x,    &scale.y,    &scale.z};
    for (int bit = 0; bit < 9; ++bit)
    {
        if (!(m_uiParentMask >> bit & 1u))
            *components[bit] = bit < 6 ? 0.0f : 1.0f;
    }
    const Mat4 inverse = Mat4InverseOrIdentity(Mat4Compose(QuatToMat3(q), kVec3Zero, scale));
    target.m_kMatrix = target.m_kMatrix * inverse;
    target.m_kMatrix.SetTranslation(target.m_kMatrix.Translation() + TransformCoord(-position, inverse));
}

} // namespace gw
