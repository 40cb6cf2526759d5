#pragma once

#include "CControl.h"
#include "CKeyArray.h"
#include "KeySpan.h"
#include "Mat4.h"
#include "Quat.h"
#include "Vec3.h"

#include <vector>

namespace gw {

class CSpatial;

/// Rotation, position and scale tracks that set the local matrix of their target, a spatial. Either all three
/// share m_kKeyTimes, index for index, or each has its own times. The caller must keep times ascending and as
/// many as there are keys; if a file has fewer keys, the last one is repeated.
class CKeyframeControl : public CControl
{
public:
    static const CRTTI ms_kRTTI;

    CKeyframeControl();
    CKeyframeControl(const CKeyframeControl& source);
    ~CKeyframeControl() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override;
    void Fields(CFieldArchive& archive) override;
    uint64_t GetMemoryUsed() const override;

    /// Always returns false: it does not animate by itself.
    bool Update(float time) override;
    bool UpdateTransform(float time) override;

    /// Computes the pose at a caller's time. Empty tracks yield the identity, the origin and (1, 1, 1).
    void GetPose(float time, Mat3& rotation, Vec3& position, Vec3& scale);

    bool m_bHasRestMatrix = false;      ///< m_kRestMatrix is valid
    Mat4 m_kRestMatrix = kMat4Identity; ///< written to the target while the control is inactive
    std::vector<Quat> m_kRotationKeys;
    CKeyArray<Vec3> m_kPositionKeys;
    CKeyArray<Vec3> m_kScaleKeys;
    std::vector<float> m_kKeyTimes; ///< times shared by the three tracks
    std::vector<float> m_kRotationTimes;
    std::vector<float> m_kPositionTimes;
    std::vector<float> m_kScaleTimes;
    /// The components of the parent's key pose that are undone here: bits 0 to 2 position x, y, z; 3 to 5
    /// rotation; 6 to 8 scale.
    uint32_t m_uiParentMask = 0;

private:
    void CancelParent(CSpatial& target, float time);

    KeyCursor m_uiKeyCursor = 0;
    KeyCursor m_uiRotationCursor = 0;
    KeyCursor m_uiPositionCursor = 0;
    KeyCursor m_uiScaleCursor = 0;
};

} // namespace gw
