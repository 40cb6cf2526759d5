#pragma once

#include "CBodyMap.h"
#include "Vec3.h"

#include <cstdint>
#include <functional>
#include <optional>
#include <string_view>

namespace gw {

/// How a body stands in a pose.
enum class ERestPose : uint8_t
{
    Unknown, ///< the arms were not found
    None,    ///< no stance at all: a leg does not point away from the trunk
    TPose,
    APose,
    ArmsDown,
    Other, ///< a stance, with the arms somewhere else
};

/// What a body's joints say of a pose. Angles are in degrees, of two limbs the larger one; no value where
/// joints are missing.
struct BodyStance
{
    Vec3 up;                         ///< from the hip to the head, else to the chest; zero if not known
    Vec3 left;                       ///< along the thighs' line, square to `up`
    Vec3 forward;                    ///< left x up
    std::optional<double> thighs;    ///< from straight down along the trunk
    std::optional<double> apart;     ///< between the thighs
    std::optional<double> shins;     ///< the same
    std::optional<double> shoulders; ///< the upper arms' line from that of the thighs
    double feet = 0.0;               ///< toes that lie ahead, from `forward`; 0 if none does
    std::optional<double> armsSide;  ///< from the line through both upper arms, outward
    std::optional<double> armsDown;  ///< from straight down along the trunk

    /// What it is, by the figures. Without legs it cannot be None, nor ArmsDown without a trunk.
    ERestPose Verdict() const;
    /// Whether a body could stand so, wherever its arms are.
    bool Stands() const;
};

/// Where a joint is in a pose, world space.
using JointPlaces = std::function<Vec3(const CNode&)>;

/// The stance of a body whose joints are at these places.
BodyStance StanceOf(const CBodyMap& body, const JointPlaces& places);
/// The stance in the rest pose of the body's tree, which need not be posed so.
BodyStance RestStanceOf(const CBodyMap& body);

/// "T-pose"; "unknown" where it is.
std::string_view RestPoseName(ERestPose pose);

} // namespace gw
