#pragma once

namespace gw {

class CNode;
struct CBodyMap;
class CRetargeter;
struct BodyMotion;
struct Alignment;
struct AlignedMotion;

/// Makes the body's hands drive those hands of the target that no row of the bone map drives or fixes.
void DriveHands(CRetargeter& table, CNode& targetRoot, const CBodyMap& body);

/// Switches a retargeter that was set up for the source to the aligned motion. Every target bone with a
/// source then points in the direction of its source. The rows' offsets, which were made for a different rest
/// pose, are replaced by the rotations from the source's aligned rest pose to the target's. If the torso is
/// driven by a joint outside the spine, it is driven by the spine instead. A collar without a source follows
/// the torso, and hip bones without a source follow the pelvis, whatever the lean of the hip's own bone.
void AimBones(CRetargeter& table, CNode& targetRoot, const BodyMotion& source, const Alignment& alignment,
              const AlignedMotion& aligned);

} // namespace gw
