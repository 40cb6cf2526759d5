#include "CEyeSpace.h"

#include "CCamera.h"

namespace gw {

CEyeSpace::CEyeSpace(const CCamera& camera, const Vec3& pan)
    : m_kEye(camera.m_kEye), m_kBack(Vec3Normalized(camera.m_kEye - camera.m_kLookAt)), m_kPan(pan)
{
    m_kRight = Vec3Normalized(Vec3Cross(camera.m_kUp, m_kBack));
    m_kUp = Vec3Cross(m_kBack, m_kRight);
}

Vec3 CEyeSpace::PlaceOf(const Vec3& world) const
{
    const Vec3 from = world - m_kEye;
    return Vec3{static_cast<float>(Vec3Dot(from, m_kRight)), static_cast<float>(Vec3Dot(from, m_kUp)),
                static_cast<float>(Vec3Dot(from, m_kBack))} +
           m_kPan;
}

} // namespace gw
