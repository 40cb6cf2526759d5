#pragma once

#include "CBodyMap.h"
#include "Corrections.h"
#include "Mat3.h"

#include <cstddef>
#include <cstdint>
#include <vector>

namespace gw {

/// How the direction of a limb's bone is determined.
enum class ELimbWays : uint8_t
{
    Offsets, ///< from the offset of the next joint at rest
    Mean,    ///< from the mean over the motion, if the motion moves the next joint
};

/// A motion to align, and the body that its joints form. The tree is not owned and must stay alive. Planning
/// changes its pose and leaves it at time 0.
struct BodyMotion
{
    CNode* root = nullptr;
    float frequency = 0.0f; ///< seconds between frames
    int frameCount = 0;
    CBodyMap body;
    ELimbWays limbs = ELimbWays::Offsets;
};

/// How an alignment changes one joint.
struct JointAlignment
{
    CNode* node = nullptr;
    int parent = -1; ///< index in Alignment::joints; -1 for the root
    /// The axes of the aligned joint, as a rotation A. In the new axes, the offsets o of its children become
    /// o · A, and its world rotation W becomes inverse(A) · W. So no joint changes its position.
    Mat3 turn = kMat3Identity;
    Vec3 restOffset = kVec3Zero; ///< in the parent's space, as stored in the file
    Vec3 axis = kVec3Zero;       ///< direction of the bone in the aligned rest pose; zero for any
    bool tellOnce = false;       ///< positions repeat the offset, so it is subtracted from them once
    bool bearsBody = false;      ///< this joint or one below it belongs to the body
};

/// How to re-express a motion relative to a rest pose that fits the bone map. Joints are in depth-first
/// order.
struct Alignment
{
    std::vector<JointAlignment> joints;
    Mat3 worldTurn = kMat3Identity; ///< rotates the whole motion so that Y is up
    /// Rotation from the space of the pelvis to that of the aligned hip. The pelvis is upright when the body
    /// stands; the aligned hip has an upright bone. The two differ because the bone from hip to spine leans
    /// relative to the pelvis.
    Mat3 pelvisTurn = kMat3Identity;
    Corrections corrections;
};

/// Plans the alignment of a motion and stores it in `alignment`. Returns false if the body has no root or
/// hip, fewer than two thighs or nothing above the hip, because then its stance is unknown, or if a computed
/// rotation is not finite.
bool PlanAlignment(const BodyMotion& motion, Alignment& alignment);

} // namespace gw
