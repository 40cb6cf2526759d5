// A foot that keeps the source's rotation but not its length has its ankle and toe at other heights. A long
// foot that rolls over its ball lifts its heel higher and swings its ankle farther ahead: the ankle slides
// while the source's stands, the knee must yield, and the toe lands late. If the source's flat foot is not
// quite flat in its rest pose, the target's toes hover. A viewer sees heights over the floor and slides
// before he sees a few degrees of pitch. So the foot is pitched a little, up to a soft limit, toward where
// the source's toe is relative to its ankle.
//
// Both its height and its distance ahead cannot be right on a foot of another length. Pitching to the height
// alone lets the ankle slide, and pitching to both equally straightens the knee at the end of a step, so the
// distance ahead counts less.

#include "FootPitch.h"

#include "Directions.h"
#include "Figures.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

constexpr double kMostPitch = 0.15;  // radians; more would look like another foot
constexpr double kUpright = 0.5;     // a foot whose horizontal part is a smaller share of it pitches less
constexpr double kAheadWeight = 0.5; // weight of the distance ahead against the height

} // namespace

ToePlace ToePlaceOf(const Vec3& ankleToToe)
{
    return {std::hypot(static_cast<double>(ankleToToe.x), static_cast<double>(ankleToToe.z)),
            static_cast<double>(ankleToToe.y)};
}

Mat3 PitchFoot(const Vec3& toe, const ToePlace& wanted)
{
    const ToePlace place = ToePlaceOf(toe);
    const double length = std::hypot(place.ahead, place.height);
    const double present = std::atan2(place.height, place.ahead);
    const double byHeight = std::asin(std::clamp(wanted.height / length, -1.0, 1.0));
    const double byBoth = std::atan2(wanted.height, std::max(wanted.ahead, 0.0));
    const double turn = byHeight + kAheadWeight * (byBoth - byHeight) - present;
    if (!(place.ahead > 0.0) || !std::isfinite(turn))
        return kMat3Identity;
    const double most = kMostPitch * Smoothstep(place.ahead / (length * kUpright));
    const double pitch = present + most * std::tanh(turn / kMostPitch);
    const auto scale = static_cast<float>(std::cos(pitch) * length / place.ahead);
    return LeastSwing(toe, {toe.x * scale, static_cast<float>(std::sin(pitch) * length), toe.z * scale});
}

Mat3 LoweredToe(const Vec3& toe, double drop)
{
    const ToePlace place = ToePlaceOf(toe);
    const double length = std::hypot(place.ahead, place.height);
    const double height = std::clamp(place.height - drop, -0.99 * length, 0.99 * length);
    const auto scale = static_cast<float>(std::sqrt(length * length - height * height) / place.ahead);
    if (!std::isfinite(scale))
        return kMat3Identity;
    return LeastSwing(toe, {toe.x * scale, static_cast<float>(height), toe.z * scale});
}

} // namespace gw
