#pragma once

#include <span>
#include <string_view>

namespace gw {

/// A part of the body and the bones of the target skeleton that make it, both sides taken together.
struct BodyPart
{
    std::string_view name; ///< as people say it: "upper arm"
    std::span<const std::string_view> bones;
};

/// The parts whose bones carry a pose: what is left out (collars, hands, feet, toes) is short, or is looked
/// at in other ways.
std::span<const BodyPart> BodyParts();

/// Whether a bone of the target skeleton belongs to one of the parts: a main bone.
bool IsMainBone(std::string_view target);

} // namespace gw
