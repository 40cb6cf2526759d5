#pragma once

#include "CControl.h"
#include "KeySpan.h"
#include "Vec3.h"

#include <vector>

namespace gw {

class CGeometry;

/// Adds an offset to each point of its target, a geometry, by a weight that changes over time. Several of
/// them on one mesh add up. Normals follow from the moved points.
class CMorphControl : public CControl
{
public:
    static const CRTTI ms_kRTTI;

    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override { return new CMorphControl(*this); }
    void Fields(CFieldArchive& archive) override;
    uint64_t GetMemoryUsed() const override;
    /// False where it is off or has keys and no target.
    bool Update(float time) override;
    bool UpdateTransform(float) override { return false; }

    std::vector<Vec3> m_kDeltas; ///< model space, from the first point on; points beyond stay
    std::vector<float> m_kWeights;
    std::vector<float> m_kKeyTimes; ///< ascending, one for each weight

private:
    void MovePoints(CGeometry& target, float weight) const;

    KeyCursor m_uiCursor = 0;
};

} // namespace gw
