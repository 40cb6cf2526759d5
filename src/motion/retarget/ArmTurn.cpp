#include "ArmTurn.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

constexpr double kStraightElbow = 0.01; // radians
constexpr double kFoldedElbow = 2.6;    // 149 degrees

} // namespace

double ReachAtElbow(const LegLengths& arm, double elbow)
{
    const double square =
        arm.upper * arm.upper + arm.lower * arm.lower + 2.0 * arm.upper * arm.lower * std::cos(elbow);
    return std::sqrt(std::max(square, 0.0));
}

double ElbowAt(const LegLengths& arm, double reach)
{
    const double cosine =
        (reach * reach - arm.upper * arm.upper - arm.lower * arm.lower) / (2.0 * arm.upper * arm.lower);
    return std::acos(std::clamp(cosine, -1.0, 1.0));
}

// Rodrigues' formula.
Vec3 Rotated(const Vec3& v, const Vec3& turn)
{
    const double angle = Vec3Length(turn);
    const Vec3 axis = Vec3Normalized(turn);
    const auto cosine = static_cast<float>(std::cos(angle));
    const auto sine = static_cast<float>(std::sin(angle));
    return v * cosine + Vec3Cross(axis, v) * sine +
           axis * (static_cast<float>(Vec3Dot(axis, v)) * (1.0f - cosine));
}

Vec3 TurnedCollar(const Vec3& collar, const Vec3& up, const ArmTurn& turn)
{
    const auto length = static_cast<float>(Vec3Length(collar));
    return Vec3Normalized(collar + up * (static_cast<float>(turn.raise) * length)) * length;
}

Vec3 TurnedHand(const LegLengths& arm, const Vec3& hand, const ArmTurn& turn)
{
    const double elbow = ElbowAt(arm, Vec3Length(hand));
    const double turned =
        std::clamp(elbow + turn.bend, std::min(elbow, kStraightElbow), std::max(elbow, kFoldedElbow));
    return Rotated(Vec3Normalized(hand), turn.turn) * static_cast<float>(ReachAtElbow(arm, turned));
}

} // namespace gw
