#pragma once

#include "BodyStance.h"

#include <cstddef>
#include <cstdint>
#include <string_view>

namespace gw {

class CMotionFile;

/// How the joints of a body were found.
enum class EBodySource : uint8_t
{
    None,
    Names,
    Shape,
};

/// What a user wants to know of a motion that is in order.
struct MotionFacts
{
    size_t jointCount = 0;
    size_t frameCount = 0;
    double frameSeconds = 0.0;
    double leg = 0.0;      ///< thigh and shin in units of the file; 0 where they are not known
    std::string_view unit; ///< what the leg's length makes of the unit; empty where it fits none
    std::string_view up;   ///< "Y" or "-Z"; empty where the hip and the feet are not known
    ERestPose restPose = ERestPose::Unknown;
    EBodySource body = EBodySource::None;
};

/// The unit in which a leg of an adult or of a child has that length, or empty.
std::string_view UnitOfLeg(double leg);
/// "names", "shape" or "none".
std::string_view BodySourceName(EBodySource source);

} // namespace gw
