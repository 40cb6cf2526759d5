#pragma once

#include "Vec3.h"

namespace gw {

class CCamera;

/// The space of a camera: x to the right, y up, z toward the viewer.
class CEyeSpace
{
public:
    /// `pan` is added to every point in camera space.
    explicit CEyeSpace(const CCamera& camera, const Vec3& pan = kVec3Zero);

    /// Transforms a point of the world.
    Vec3 PlaceOf(const Vec3& world) const;

private:
    Vec3 m_kEye;
    Vec3 m_kRight;
    Vec3 m_kUp;
    Vec3 m_kBack;
    Vec3 m_kPan;
};

} // namespace gw
