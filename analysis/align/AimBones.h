#pragma once

namespace gw {

class CNode;
struct CBodyMap;
class CRetargeter;
struct BodyMotion;
struct Alignment;
struct AlignedMotion;

/// Lets the hands that a body has drive those of the target that no row of the map drives or fixes.
void DriveHands(CRetargeter& table, CNode& targetRoot, const CBodyMap& body);

/// Hands a retargeter, filled for the source, over to the aligned motion. Every target bone that a row drives
/// points as its source does: offsets become what takes the source's aligned rest pose to the target's, and
/// those of the rows, which were made against another rest pose, are set aside. A torso that is driven from
/// beside the spine takes the spine's joints instead; a collar without a source goes along with the torso,
/// and hip bones with the pelvis, however the hip's bone leans from it.
void AimBones(CRetargeter& table, CNode& targetRoot, const BodyMotion& source, const Alignment& alignment,
              const AlignedMotion& aligned);

} // namespace gw
