#pragma once

#include "Vec3.h"

#include <span>

namespace gw {

/// A bounding sphere in the world space of its owner.
struct BoundSphere
{
    Vec3 m_kCentre = kVec3Zero;
    float m_fRadius = 0.0f;

    /// Grows this sphere to include another one.
    void Merge(const BoundSphere& other);
};

/// Returns the sphere around the center of the points' axis-aligned box; zero without points.
BoundSphere BoundOfPoints(std::span<const Vec3> points);

} // namespace gw
