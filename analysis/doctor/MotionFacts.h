#pragma once

#include "CBodyMap.h"

#include <cstddef>
#include <cstdint>
#include <string_view>

namespace gw {

class CMotionFile;

/// How a skeleton stands where all its rotations are 0.
enum class ERestPose : uint8_t
{
    Unknown, ///< the arms or legs were not found
    None,    ///< no stance at all: legs and torso point the same way
    TPose,
    APose,
    ArmsDown,
    Other, ///< upright, with the arms somewhere else
};

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
/// How a body stands at rest.
ERestPose RestPoseOf(const CBodyMap& body);

/// "T-pose"; "unknown" where it is.
std::string_view RestPoseName(ERestPose pose);
/// "names", "shape" or "none".
std::string_view BodySourceName(EBodySource source);

} // namespace gw
