#pragma once

#include "Vec3.h"

#include <span>
#include <vector>

namespace gw {

// A foot starts to stand when it is below kStandHeight and slower than kStandSpeed, and stands until it is
// above kLeaveHeight or faster than kLeaveSpeed. In between, it keeps its state, so noise at a threshold does
// not start a new contact. Heights are in leg lengths above the floor, speeds in leg lengths per second; a
// leg is about 85 cm.
inline constexpr double kStandHeight = 0.06; ///< 5 cm: allows for carpets, soft floors, a sensor that slipped
inline constexpr double kLeaveHeight = 0.1;  ///< 9 cm: half the rise of an ankle in a step
inline constexpr double kStandSpeed = 0.35;  ///< 30 cm/s: a tenth of a walking foot's swing speed
inline constexpr double kLeaveSpeed = 0.6;   ///< 50 cm/s: a heel that peels off exceeds it within 1/50 s
/// Speeds are measured over this many seconds, so jitter in recordings with a high frame rate is not taken
/// for speed.
inline constexpr double kSpeedSeconds = 1.0 / 30.0;
/// Shorter touches are ignored: the foot only brushes the floor. Sprinters stand for 0.09 s.
inline constexpr double kLeastContactSeconds = 0.08;
/// The floor of a joint is this percentile of its heights, as a share, over both feet together. It is low
/// enough to be a height at which the joint stands in nearly any motion, and high enough to ignore outliers.
inline constexpr double kFloorShare = 0.05;

/// A range of frames in which one foot is on the ground.
struct Contact
{
    int first; ///< first frame in which the foot stands
    int end;   ///< first frame in which it no longer does
};

/// A joint's world positions, frame by frame, and the height at which it stands.
struct FloorPath
{
    std::span<const Vec3> positions;
    float floor;
};

/// How a joint, or the joints of a foot together, move in a frame.
struct FootMotion
{
    double height; ///< of the highest joint above its floor
    double speed;  ///< of the fastest joint; the lower of the speeds before and after the frame
};

/// Returns how a joint moves, one value per frame, in the unit of the positions.
std::vector<FootMotion> MotionOf(const FloorPath& joint, double secondsPerFrame);
/// Returns how two joints move together, one value per frame. Both lists must have the same length.
std::vector<FootMotion> JointMotion(const std::vector<FootMotion>& first,
                                    const std::vector<FootMotion>& second);
/// Returns the contacts of a foot from its motion, as below.
std::vector<Contact> FindContacts(std::span<const FootMotion> motion, double leg, double secondsPerFrame);

/// Returns the contacts of a foot, in order: the frames in which all its joints (ankle, toe) are low and slow
/// at the same time. All paths must have the same number of frames. `leg` is the leg's length in the unit of
/// the positions and must be above 0.
std::vector<Contact> FindContacts(std::span<const FloorPath> joints, double leg, double secondsPerFrame);

/// Returns the union of two lists of contacts, in order. Contacts that meet or overlap are merged.
std::vector<Contact> MergedContacts(std::vector<Contact> contacts, const std::vector<Contact>& more);

} // namespace gw
