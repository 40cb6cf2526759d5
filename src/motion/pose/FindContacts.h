#pragma once

#include "Vec3.h"

#include <span>
#include <vector>

namespace gw {

// A foot begins to stand when it is lower and slower than the first figure of each row, and goes on until it
// is higher or faster than the second; in between it does what it did, so that noise at a threshold makes no
// new contact. Heights are leg lengths above the floor, speeds leg lengths a second; a leg is about 85 cm.
inline constexpr double kStandHeight =
    0.06;                                   ///< 5 cm: carpets, soft floors, a sensor that slipped on the shoe
inline constexpr double kLeaveHeight = 0.1; ///< 9 cm: half of what an ankle rises in a step
inline constexpr double kStandSpeed = 0.35; ///< 30 cm/s: a tenth of a walking foot's swing
inline constexpr double kLeaveSpeed =
    0.6; ///< 50 cm/s: a heel that peels off is faster within a fiftieth of a second
/// Speeds are taken over this many seconds, so that jitter of a fast recording is no speed.
inline constexpr double kSpeedSeconds = 1.0 / 30.0;
/// A shorter touch is a foot that brushes the floor: sprinters stand for 0.09 s.
inline constexpr double kLeastContactSeconds = 0.08;
/// The floor of a joint is this percentile of its heights, both feet taken together: low enough to be one at
/// which it stands in nearly any motion, high enough for an outlier not to count.
inline constexpr double kFloorShare = 0.05;

/// Frames of one foot on the ground.
struct Contact
{
    int first; ///< first frame that stands
    int end;   ///< first frame that does not
};

/// A joint's world positions, frame by frame, and the height at which it stands.
struct FloorPath
{
    std::span<const Vec3> positions;
    float floor;
};

/// The contacts of a foot whose joints (ankle, toe) have to be low and slow together. All paths are of one
/// length. `leg` is in the unit of the positions and above 0.
std::vector<Contact> FindContacts(std::span<const FloorPath> joints, double leg, double secondsPerFrame);

/// The frames of two lists of contacts together, in order; contacts that meet or overlap become one.
std::vector<Contact> MergedContacts(std::vector<Contact> contacts, const std::vector<Contact>& more);

} // namespace gw
