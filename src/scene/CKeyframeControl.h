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

/// Rotation, position and scale tracks that rewrite the local matrix of their target, a spatial. Either
/// m_kKeyTimes is filled and all three run on it, index for index, or each has its own time axis. Times are
/// ascending; keeping them so and as long as the keys is the caller's duty, and where files did not, the last
/// key there is stands in.
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

    /// Never animates by itself: false.
    bool Update(float time) override;
    bool UpdateTransform(float time) override;

    /// The pose at a caller's time. Empty tracks give the identity, the origin and (1, 1, 1).
    void GetPose(float time, Mat3& rotation, Vec3& position, Vec3& scale);

    bool m_bHasRestMatrix = false;      ///< m_kRestMatrix is valid
    Mat4 m_kRestMatrix = kMat4Identity; ///< written to the target while the control is inactive
    std::vector<Quat> m_kRotationKeys;
    CKeyArray<Vec3> m_kPositionKeys;
    CKeyArray<Vec3> m_kScaleKeys;
    std::vector<float> m_kKeyTimes; ///< the axis that the three tracks share
    std::vector<float> m_kRotationTimes;
    std::vector<float> m_kPositionTimes;
    std::vector<float> m_kScaleTimes;
    /// Which parts of the parent's key pose are undone here: bits 0 to 2 position x, y, z; 3 to 5 rotation; 6
    /// to 8 scale.
    uint32_t m_uiParentMask = 0;

private:
    void CancelParent(CSpatial& target, float time);

    KeyCursor m_uiKeyCursor = 0;
    KeyCursor m_uiRotationCursor = 0;
    KeyCursor m_uiPositionCursor = 0;
    KeyCursor m_uiScaleCursor = 0;
};

} // namespace gw
