#pragma once

#include "FindContacts.h"
#include "Vec3.h"

#include <span>
#include <vector>

namespace gw {

/// How a foot is held over the ground in one frame.
struct FootHold
{
    float share =
        0.0f; ///< 0 where the foot goes with its leg, 1 where it stands; between at a contact's ends
    Vec3 place = kVec3Zero; ///< where it stands; x and z count
};

/// The ways of a foot, place by place of every frame.
struct FootPaths
{
    std::span<const Vec3> path;   ///< as it would go if nothing held it
    std::span<const Vec3> source; ///< as the source's goes
    double scale;                 ///< of the source's lengths
};

/// Holds a foot in the frames of the contacts: in one place, near to its own path in the contact's middle.
/// Where the source's foot drifts farther off than `play` in a contact, the place goes with it. Holds fade at
/// the ends of a contact over `fadeFrames`, the smaller part of which lies outside.
std::vector<FootHold> HoldFoot(const FootPaths& foot, std::span<const Contact> contacts, double play,
                               double fadeFrames);

} // namespace gw
