#pragma once

#include "FindContacts.h"
#include "Vec3.h"

#include <span>
#include <vector>

namespace gw {

/// The ways of a foot, place by place of every frame, all in the target's lengths.
struct FootPaths
{
    std::span<const Vec3> free;        ///< the target's ankle, as it would go if nothing held it
    std::span<const Vec3> toe;         ///< from the target's ankle to its toe
    std::span<const Vec3> sourceAnkle; ///< of the source
    std::span<const Vec3> sourceToe;   ///< of the source
    double leg;                        ///< length
};

/// Where the ankle goes over the ground so that the foot stands still in the frames of the contacts, and
/// rolls over its toe where the source's does: x and z of every frame. y is that of the free path. Outside of
/// contacts the ankle goes back to its free path.
std::vector<Vec3> HoldFoot(const FootPaths& foot, std::span<const Contact> contacts, double secondsPerFrame);

} // namespace gw
