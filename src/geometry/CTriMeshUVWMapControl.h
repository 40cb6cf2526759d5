#pragma once

#include "CControl.h"
#include "KeySpan.h"
#include "Vec3.h"

#include <vector>

namespace gw {

class CTriMeshUVWMap;

/// Plays frames of texture coordinates on its target, a mesh's map, without blending between frames.
class CTriMeshUVWMapControl : public CControl
{
public:
    static const CRTTI ms_kRTTI;

    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override { return new CTriMeshUVWMapControl(*this); }
    void Fields(CFieldArchive& archive) override;
    uint64_t GetMemoryUsed() const override;
    /// Returns false if it is inactive or its target is not a map.
    bool Update(float time) override;
    bool UpdateTransform(float) override { return false; }

    std::vector<Vec3> m_kFrames;    ///< consecutive frames, each as long as the target's coordinates
    std::vector<float> m_kKeyTimes; ///< ascending, one per frame

private:
    void ShowFrame(CTriMeshUVWMap& map, size_t frame) const;

    KeyCursor m_uiCursor = 0;
};

} // namespace gw
