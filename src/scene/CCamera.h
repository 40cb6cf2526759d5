#pragma once

#include "CSpatial.h"

#include <array>

namespace gw {

/// The point that a camera looks at.
class CCameraTarget : public CSpatial
{
public:
    static const CRTTI ms_kRTTI;

    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override { return new CCameraTarget(*this); }
    void UpdateBound() override {}
    void ApplyRenderStates(RenderStateStack&) override {}
};

/// A camera: eye, look-at point and up vector in local space. By default it looks from the origin along -Z,
/// with Y up.
class CCamera : public CSpatial
{
public:
    static const CRTTI ms_kRTTI;

    CCamera();
    CCamera(const CCamera& source);
    ~CCamera() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override;
    void Fields(CFieldArchive& archive) override;
    uint64_t GetMemoryUsed() const override;
    bool Update(float time) override;
    void UpdateBound() override {}
    void ApplyRenderStates(RenderStateStack&) override {}

    CCameraTarget* GetCameraTarget() const { return m_spkCameraTarget.Get(); }
    void SetCameraTarget(CCameraTarget* target) { m_spkCameraTarget = target; }

    std::array<float, 7> m_afParameter{1.0f, 2.0f, 1.0f, 0.0f, 1.0f, 0.0f, 1.0f}; ///< stored and copied only
    Vec3 m_kEye = kVec3Zero;
    Vec3 m_kUp = kVec3UnitY;
    Vec3 m_kWorldEye = kVec3Zero;      ///< m_kEye in world space, set by Update; not stored
    Vec3 m_kControlVector = kVec3Zero; ///< set by a camera control; not stored
    bool m_bCameraFlagA = true;        ///< stored and copied only
    bool m_bCameraFlagB = true;        ///< stored and copied only
    Vec3 m_kLookAt{0.0f, 0.0f, -1.0f};

protected:
    void AppendBindOrder(std::vector<CObject*>& order) override;

private:
    Held<CCameraTarget> m_spkCameraTarget;
};

} // namespace gw
