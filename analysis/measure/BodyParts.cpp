#include "BodyParts.h"

#include <algorithm>

namespace gw {

namespace {

constexpr std::string_view kUpperArms[] = {"LUpperArm", "RUpperArm"};
constexpr std::string_view kForearms[] = {"LForearm", "RForearm"};
constexpr std::string_view kThighs[] = {"LThigh", "RThigh"};
constexpr std::string_view kCalves[] = {"LCalf", "RCalf"};
constexpr std::string_view kSpine[] = {"LowerTorso", "Waist", "UpperTorso"};
constexpr std::string_view kNeck[] = {"Neck"};
constexpr std::string_view kHead[] = {"Head"};

constexpr BodyPart kParts[] = {
    {"upper arm", kUpperArms},
    {"forearm",   kForearms },
    {"thigh",     kThighs   },
    {"calf",      kCalves   },
    {"spine",     kSpine    },
    {"neck",      kNeck     },
    {"head",      kHead     },
};

} // namespace

std::span<const BodyPart> BodyParts()
{
    return kParts;
}

bool IsMainBone(std::string_view target)
{
    return std::ranges::any_of(
        kParts, [=](const BodyPart& part) { return std::ranges::count(part.bones, target) != 0; });
}

} // namespace gw
