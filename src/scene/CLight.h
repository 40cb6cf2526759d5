#pragma once

#include "CSpatial.h"

namespace gw {

/// Base of all lights: color and intensity.
class CLight : public CSpatial
{
public:
    static const CRTTI ms_kRTTI;

    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    void Fields(CFieldArchive& archive) override;
    void DumpTable(CHTMLTables& tables) override;
    uint64_t GetMemoryUsed() const override;
    void UpdateBound() override {}
    void ApplyRenderStates(RenderStateStack&) override {}
    virtual uint32_t GetLightType() const = 0;

    Vec3 m_kRGB = kVec3Zero;
    float m_fIntensity = 1.0f;
    bool m_bLightOn = true; ///< stored and copied only
};

/// A point light.
class CPointLight : public CLight
{
public:
    static const CRTTI ms_kRTTI;

    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override { return new CPointLight(*this); }
    void Fields(CFieldArchive& archive) override;
    void DumpTable(CHTMLTables& tables) override;
    uint64_t GetMemoryUsed() const override;
    bool Update(float time) override;
    uint32_t GetLightType() const override { return 2; }

    Vec3 m_kLocation = kVec3Zero;
    Vec3 m_kWorldLocation = kVec3Zero; ///< in world space, set by Update; not stored
    uint32_t m_uiLightWord = 0;        ///< copied, not stored
};

} // namespace gw
