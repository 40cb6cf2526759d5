#pragma once

#include "Vec3.h"

#include <span>

namespace gw {

/// A bounding sphere, in the space of its holder's world.
struct BoundSphere
{
    Vec3 m_kCentre = kVec3Zero;
    float m_fRadius = 0.0f;

    /// Grows this sphere until it holds the other one too.
    void Merge(const BoundSphere& other);
};

/// The sphere around the middle of the points' axis-aligned box; zero for no points.
BoundSphere BoundOfPoints(std::span<const Vec3> points);

} // namespace gw
