#pragma once

#include "CControl.h"
#include "KeySpan.h"
#include "Vec3.h"

#include <vector>

namespace gw {

class CGeometry;

/// Adds weighted offsets to the points of its target, a geometry; the weight changes over time. Several
/// morphs on one mesh add up. Normals are computed from the moved points.
class CMorphControl : public CControl
{
public:
    static const CRTTI ms_kRTTI;

    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override { return new CMorphControl(*this); }
    void Fields(CFieldArchive& archive) override;
    uint64_t GetMemoryUsed() const override;
    /// Returns false if it is inactive, or has keys but no target.
    bool Update(float time) override;
    bool UpdateTransform(float) override { return false; }

    std::vector<Vec3> m_kDeltas; ///< model space, starting at the first point; later points do not move
    std::vector<float> m_kWeights;
    std::vector<float> m_kKeyTimes; ///< ascending, one per weight

private:
    void MovePoints(CGeometry& target, float weight) const;

    KeyCursor m_uiCursor = 0;
};

} // namespace gw
