#pragma once

#include "BodyJoints.h"
#include "HostBones.h"

#include <cstddef>
#include <cstdint>

namespace gw {

/// What the direction of a host bone is derived from.
enum class EHostAim : uint8_t
{
    None,
    Next,  ///< the next joint that has a row
    Child, ///< the joint below, if any (feet)
    Hand,  ///< the knuckles, otherwise the forearm's direction
    Head,  ///< upright in a stance
};

/// What drives a host bone, and how it is related to others.
struct HostRow
{
    const char* target;
    EBodyJoint joint;
    EBodySide side;
    EHostAim aim;
    int next;   ///< how many of the following rows can be its next joint; the first with a source is used
    int parent; ///< how many rows before it its parent's row is; 0 if the parent has no source
};

/// The host skeleton's bones, in profile order.
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
