#pragma once

#include "BodyStance.h"

#include <cstddef>
#include <cstdint>
#include <string_view>

namespace gw {

class CMotionFile;

/// How the joints of a body were identified.
enum class EBodySource : uint8_t
{
    None,
    Names,
    Shape,
};

/// Facts about a valid motion that a user wants to know.
struct MotionFacts
{
    size_t jointCount = 0;
    size_t frameCount = 0;
    double frameSeconds = 0.0; ///< time between frames
    double leg = 0.0;          ///< thigh and shin in file units; 0 if unknown
    std::string_view unit;     ///< the file's, or the one suggested by the leg's length; empty if unknown
    std::string_view up;       ///< "Y" or "-Z"; empty if hip or feet are unknown
    ERestPose restPose = ERestPose::Unknown;
    EBodySource body = EBodySource::None;
};

/// Returns the unit in which an adult's or a child's leg has this length, or empty.
std::string_view UnitOfLeg(double leg);
/// Returns the unit of this length, or empty if it is an unusual one.
std::string_view UnitOfMeters(double meters);
/// Returns the length of a unit in meters if a leg is so many units long. If the leg suggests no unit, the
/// body is an adult's; 1 for a leg of 0.
double MetersOfUnit(double leg);
/// Returns "names", "shape" or "none".
std::string_view BodySourceName(EBodySource source);

} // namespace gw
