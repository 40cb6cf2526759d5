#pragma once

#include "CBodyMap.h"
#include "Corrections.h"
#include "Mat3.h"

#include <cstddef>
#include <cstdint>
#include <vector>

namespace gw {

/// Along which way a limb's bone is taken to lie.
enum class ELimbWays : uint8_t
{
    Offsets, ///< that to the next joint at rest
    Mean,    ///< for a joint below that the motion moves, the mean one of the motion
};

/// A motion that is to be aligned, and what its joints are. The tree is looked at and not kept alive; it is
/// posed on the way and left at time 0.
struct BodyMotion
{
    CNode* root = nullptr;
    float frequency = 0.0f; ///< seconds from frame to frame
    int frameCount = 0;
    CBodyMap body;
    ELimbWays limbs = ELimbWays::Offsets;
};

/// What an alignment does to one joint.
struct JointAlignment
{
    CNode* node = nullptr;
    int parent = -1;
    /// The aligned joint's axes as rotation A: seen from it, its children's offsets o become o · A, and its
    /// world rotation W becomes inverse(A) · W. So no joint changes its place.
    Mat3 turn = kMat3Identity;
    Vec3 restOffset = kVec3Zero; ///< in the parent's space, as the file has it
    Vec3 axis = kVec3Zero;       ///< along which the bone lies in the aligned rest pose; zero for any
    bool tellOnce = false;       ///< positions repeat the offset: it is taken off them once
    bool bearsBody = false;      ///< a joint of the body stands here or below
};

/// How a motion is told from a rest pose that suits the rules. Joints stand depth first.
struct Alignment
{
    std::vector<JointAlignment> joints;
    Mat3 worldTurn = kMat3Identity; ///< turns the whole motion so that Y is up
    /// Takes the space of the pelvis, upright where the body stands, to that of the aligned hip, whose bone
    /// is upright: the way to the spine leans from the pelvis.
    Mat3 pelvisTurn = kMat3Identity;
    Corrections corrections;
};

/// Works out the alignment of a motion. False where its body has no hip, no two thighs or nothing above the
/// hip, without which there is no stance to tell it from.
bool PlanAlignment(const BodyMotion& motion, Alignment& alignment);

} // namespace gw
