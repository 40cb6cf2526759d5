#pragma once

#include "BodyJoints.h"
#include "CheckBody.h"

#include <array>
#include <cstdint>
#include <vector>

namespace gw {

/// The evidence for a joint's role, from weakest to strongest.
enum class EBodyEvidence : uint8_t
{
    None,      ///< the skeleton has no such joint
    Shape,     ///< positions and bone lengths; the name says nothing
    ShapeOnly, ///< positions and bone lengths, contradicting the name
    Name,      ///< its name; the shape says nothing or contradicts
    Both,      ///< name and shape
};

/// A body found in a skeleton, and the confidence in it.
struct FoundBody
{
    CBodyMap body; ///< lacks the thirteen required joints if no body was found; see CBodyMap::DrivesBody
    std::array<EBodyEvidence, kBodyPlaceCount> evidence{}; ///< in the order of BodyPlaces()
    std::vector<BodyDoubt> doubts;                         ///< remaining doubts
    bool sidesAreSure = true;                              ///< names or poses show which side is the left one

    EBodyEvidence Evidence(BodyPlace place) const { return evidence[IndexOf(place)]; }
};

/// Finds the body of a skeleton: by joint names if they describe a whole body that the positions do not
/// contradict, otherwise by shape. Joints that one method misses are added from the other. The tree is posed
/// during the call and restored.
FoundBody FindBody(CNode& root);

} // namespace gw
