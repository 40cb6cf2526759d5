#pragma once

#include <array>
#include <string_view>

namespace gw {

// Names of the host skeleton's bones, which every result contains.

/// The bone that every conversion must map.
inline constexpr const char* kRootBone = "LowerTorso";
inline constexpr const char* kWaistBone = "Waist";
inline constexpr const char* kTorsoBone = "UpperTorso";
inline constexpr const char* kNeckBone = "Neck";
inline constexpr const char* kHeadBone = "Head";

/// The bones of one side, from the trunk outward.
struct HostSide
{
    const char* collar;
    const char* upperArm;
    const char* forearm;
    const char* hand;
    const char* pelvis;
    const char* thigh;
    const char* calf;
    const char* foot;
    const char* toe;
};
inline constexpr HostSide kLeftBones{"LCollar", "LUpperArm", "LForearm", "LHand", "LPelvis",
                                     "LThigh",  "LCalf",     "LFoot",    "LToe"};
inline constexpr HostSide kRightBones{"RCollar", "RUpperArm", "RForearm", "RHand", "RPelvis",
                                      "RThigh",  "RCalf",     "RFoot",    "RToe"};
/// Indexed by EBodySide.
inline constexpr std::array kHostSides{kLeftBones, kRightBones};

/// The bones that no source bone drives: every profile has a fixed row for each.
inline constexpr std::string_view kPelvisBones[] = {kLeftBones.pelvis, kRightBones.pelvis};

} // namespace gw
