#pragma once

#include "CBodyMap.h"
#include "Vec3.h"

#include <cstdint>
#include <functional>
#include <optional>
#include <string_view>

namespace gw {

/// The kind of a body's pose at rest.
enum class ERestPose : uint8_t
{
    Unknown, ///< the arms were not found
    None,    ///< not a standing pose: a leg does not point away from the trunk
    TPose,
    APose,
    ArmsDown,
    Other, ///< a standing pose with the arms in another position
};

/// Measurements of a pose. Angles are degrees; for a pair of limbs, the larger angle. Empty if joints are
/// missing.
struct BodyStance
{
    Vec3 up;                         ///< from the hip to the head, or to the chest; zero if unknown
    Vec3 left;                       ///< along the line between the thighs, perpendicular to `up`
    Vec3 forward;                    ///< left x up
    std::optional<double> thighs;    ///< thighs against straight down along the trunk
    std::optional<double> apart;     ///< angle between the thighs
    std::optional<double> shins;     ///< shins against straight down along the trunk
    std::optional<double> shoulders; ///< line of the upper arms against that of the thighs
    double feet = 0.0;               ///< toes against `forward`, if they point ahead; otherwise 0
    std::optional<double> armsSide;  ///< arms against the line through both upper arms, outward
    std::optional<double> armsDown;  ///< arms against straight down along the trunk

    /// Classifies the pose. Without legs the result is never None; without a trunk it is never ArmsDown.
    ERestPose Verdict() const;
    /// Whether the legs are those of a standing body, wherever its arms are.
    bool Stands() const;
    /// Whether the turns of bones can be measured in it: the legs continue the trunk, and shoulders and feet
    /// face the same way as the hips.
    bool IsReference() const;
};

/// Returns a joint's world position in a pose.
using JointPlaces = std::function<Vec3(const CNode&)>;

/// Measures a body whose joints are at the given positions.
BodyStance StanceOf(const CBodyMap& body, const JointPlaces& places);
/// Measures the rest pose of the body's tree, whatever its current pose.
BodyStance RestStanceOf(const CBodyMap& body);

/// The pose's name, such as "T-pose" or "unknown".
std::string_view RestPoseName(ERestPose pose);

} // namespace gw
