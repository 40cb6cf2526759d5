#include "BodyParts.h"

#include "HostBones.h"

#include <algorithm>

namespace gw {

namespace {

constexpr std::string_view kUpperArms[] = {kLeftBones.upperArm, kRightBones.upperArm};
constexpr std::string_view kForearms[] = {kLeftBones.forearm, kRightBones.forearm};
constexpr std::string_view kThighs[] = {kLeftBones.thigh, kRightBones.thigh};
constexpr std::string_view kCalves[] = {kLeftBones.calf, kRightBones.calf};
constexpr std::string_view kSpine[] = {kRootBone, kWaistBone, kTorsoBone};
constexpr std::string_view kNeck[] = {kNeckBone};
constexpr std::string_view kHead[] = {kHeadBone};

constexpr BodyPart kParts[] = {
    {"upper arm", kUpperArms},
    {"forearm",   kForearms },
    {"thigh",     kThighs   },
    {"calf",      kCalves   },
    {"spine",     kSpine    },
    {"neck",      kNeck     },
    {"head",      kHead     },
};
constexpr size_t kLimbParts = 4; // the first of them

bool IsInAny(std::span<const BodyPart> parts, std::string_view target)
{
    return std::ranges::any_of(
        parts, [=](const BodyPart& part) { return std::ranges::count(part.bones, target) != 0; });
}

} // namespace

std::span<const BodyPart> BodyParts()
{
    return kParts;
}

bool IsMainBone(std::string_view target)
{
    return IsInAny(kParts, target);
}

bool IsLimb(std::string_view target)
{
    return IsInAny(std::span(kParts).first(kLimbParts), target);
}

} // namespace gw
