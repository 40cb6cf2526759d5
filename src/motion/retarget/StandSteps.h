#pragma once

#include "FindContacts.h"
#include "Vec3.h"

#include <cstddef>
#include <span>
#include <vector>

namespace gw {

/// The paths of a foot: one position per frame, all in the target's scale.
struct FootPaths
{
    std::span<const Vec3> toe;         ///< vector from the target's ankle to its toe
    std::span<const Vec3> sourceAnkle; ///< the source's ankle
    std::span<const Vec3> sourceToe;   ///< the source's toe
    double leg;                        ///< length of the target's leg
};

/// When the source's foot stands, each list in order.
struct FootStands
{
    std::span<const Contact> contacts; ///< frames in which the ankle or the toe stands
    std::span<const Contact> ankle;    ///< frames in which the ankle stands
    std::span<const Contact> toe;      ///< same for the toe
    std::span<const size_t> jumps;     ///< frames after which the source jumps
};

/// How a foot moves over the ground while it stands.
struct StandingFoot
{
    /// The ankle's step from each frame to the next; zero outside of contacts.
    std::vector<Vec3> steps;
    /// How much farther the ankle slides in each of its stands than the source's, in millimeters of the
    /// target; negative if it slides less.
    std::vector<double> ankleSlides;
    /// Same for the toe.
    std::vector<double> toeSlides;
};

/// Returns the steps with which a foot stands still, and rolls over its toe when the source's foot does. If
/// one of its joints would slide noticeably farther than the source's, ankle and toe share the slide.
StandingFoot StandSteps(const FootPaths& foot, const FootStands& stands, double secondsPerFrame);

} // namespace gw
