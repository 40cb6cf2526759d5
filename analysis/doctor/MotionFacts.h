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
    std::string_view unit;     ///< the unit suggested by the leg's length; empty if none fits
    std::string_view up;       ///< "Y" or "-Z"; empty if hip or feet are unknown
    ERestPose restPose = ERestPose::Unknown;
    EBodySource body = EBodySource::None;
};

/// Returns the unit in which an adult's or a child's leg has this length, or empty.
std::string_view UnitOfLeg(double leg);
/// Returns "names", "shape" or "none".
std::string_view BodySourceName(EBodySource source);

} // namespace gw
