#pragma once

#include "BodyJoints.h"
#include "CheckBody.h"

#include <array>
#include <cstdint>
#include <vector>

namespace gw {

/// What tells that a joint has its place in a body, from nothing to most.
enum class EBodyEvidence : uint8_t
{
    None,      ///< the skeleton has no such joint
    Shape,     ///< places and lengths of bones, the names say nothing
    ShapeOnly, ///< places and lengths of bones, against what the names say
    Name,      ///< its name, the shape says nothing or something else
    Both,      ///< name and shape
};

/// A body that was found in a skeleton, and how surely.
struct FoundBody
{
    CBodyMap body; ///< without the thirteen joints where none was found; see CBodyMap::DrivesBody
    std::array<EBodyEvidence, kBodyPlaceCount> evidence{}; ///< in the order of BodyPlaces()
    std::vector<BodyDoubt> doubts;                         ///< that are left
    bool sidesAreSure = true; ///< the names or the poses show which side is the left one

    EBodyEvidence Evidence(BodyPlace place) const { return evidence[IndexOf(place)]; }
};

/// Finds the body of a skeleton: by the names of its joints where these give a whole body that the places of
/// the joints do not contradict, else by its shape. What the one does not know the other may add. The tree is
/// posed meanwhile and left as it was.
FoundBody FindBody(CNode& root);

} // namespace gw
