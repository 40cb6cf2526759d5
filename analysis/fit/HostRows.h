#pragma once

#include "BodyJoints.h"
#include "HostBones.h"

#include <cstddef>
#include <cstdint>

namespace gw {

/// Where the direction of a bone of the host skeleton comes from.
enum class EHostAim : uint8_t
{
    None,
    Next,  ///< towards the next joint that has a row
    Child, ///< towards the joint below, where there is one: a foot
    Hand,  ///< towards the knuckles, else as the forearm
    Head,  ///< upright in a stance
};

/// What drives a bone of the host skeleton, and how it hangs together with others.
struct HostRow
{
    const char* target;
    EBodyJoint joint;
    EBodySide side;
    EHostAim aim;
    int next;   ///< how many of the rows behind it may be its next joint, the first that has a source counts
    int parent; ///< how many rows before it the row of its parent stands; 0 where that has no source
};

/// The host skeleton's bones, in the order of its profiles.
inline constexpr HostRow kHostRows[] = {
    {kRootBone,            EBodyJoint::Hip,      EBodySide::Left,  EHostAim::Next,  2, 0},
    {kWaistBone,           EBodyJoint::Spine,    EBodySide::Left,  EHostAim::Next,  1, 1},
    {kTorsoBone,           EBodyJoint::Spine,    EBodySide::Left,  EHostAim::Next,  2, 1},
    {kNeckBone,            EBodyJoint::Neck,     EBodySide::Left,  EHostAim::Next,  1, 1},
    {kHeadBone,            EBodyJoint::Head,     EBodySide::Left,  EHostAim::Head,  0, 1},
    {kLeftBones.collar,    EBodyJoint::Clavicle, EBodySide::Left,  EHostAim::Next,  1, 3},
    {kLeftBones.upperArm,  EBodyJoint::UpperArm, EBodySide::Left,  EHostAim::Next,  1, 1},
    {kLeftBones.forearm,   EBodyJoint::Forearm,  EBodySide::Left,  EHostAim::Next,  1, 1},
    {kLeftBones.hand,      EBodyJoint::Hand,     EBodySide::Left,  EHostAim::Hand,  0, 1},
    {kRightBones.collar,   EBodyJoint::Clavicle, EBodySide::Right, EHostAim::Next,  1, 7},
    {kRightBones.upperArm, EBodyJoint::UpperArm, EBodySide::Right, EHostAim::Next,  1, 1},
    {kRightBones.forearm,  EBodyJoint::Forearm,  EBodySide::Right, EHostAim::Next,  1, 1},
    {kRightBones.hand,     EBodyJoint::Hand,     EBodySide::Right, EHostAim::Hand,  0, 1},
    {kLeftBones.pelvis,    EBodyJoint::Hip,      EBodySide::Left,  EHostAim::None,  0, 0},
    {kLeftBones.thigh,     EBodyJoint::Thigh,    EBodySide::Left,  EHostAim::None,  0, 0},
    {kLeftBones.calf,      EBodyJoint::Shin,     EBodySide::Left,  EHostAim::None,  0, 1},
    {kLeftBones.foot,      EBodyJoint::Foot,     EBodySide::Left,  EHostAim::Child, 0, 1},
    {kRightBones.pelvis,   EBodyJoint::Hip,      EBodySide::Right, EHostAim::None,  0, 0},
    {kRightBones.thigh,    EBodyJoint::Thigh,    EBodySide::Right, EHostAim::None,  0, 0},
    {kRightBones.calf,     EBodyJoint::Shin,     EBodySide::Right, EHostAim::None,  0, 1},
    {kRightBones.foot,     EBodyJoint::Foot,     EBodySide::Right, EHostAim::Child, 0, 1},
};
inline constexpr size_t kWaistRow = 1;

} // namespace gw
