#pragma once

#include <span>
#include <string_view>

namespace gw {

/// A part of the body, and the target bones that belong to it, on both sides.
struct BodyPart
{
    std::string_view name; ///< its usual name: "upper arm"
    std::span<const std::string_view> bones;
};

/// Returns the parts whose bones determine a pose. The others (collars, hands, feet, toes) are short, or are
/// measured differently.
std::span<const BodyPart> BodyParts();

/// Returns whether a target bone belongs to one of the parts, that is, is a main bone.
bool IsMainBone(std::string_view target);

/// Returns whether a target bone is an upper arm, a forearm, a thigh or a calf.
bool IsLimb(std::string_view target);

} // namespace gw
