#pragma once

#include "Alignment.h"
#include "CNode.h"

#include <cstdint>
#include <vector>

namespace gw {

/// A motion expressed relative to another rest pose.
struct AlignedMotion
{
    Ref<CNode> root;
    std::vector<CNode*> joints; ///< in the order of the alignment's joints
};

/// Which joints of an aligned motion move.
enum class EAlignedJoints : uint8_t
{
    All,
    Body, ///< the body's joints and their ancestors; fingers and faces keep their rest pose
};

/// Expresses a motion relative to the rest pose of its alignment, as a new tree: a track and a bone mesh for
/// each joint, whose world positions equal the source's at every frame, rotated so that Y is up. The body's
/// bones have the frames of the target's bones at rest. A track contains positions only if they change.
AlignedMotion AlignMotion(const BodyMotion& motion, const Alignment& alignment,
                          EAlignedJoints joints = EAlignedJoints::All);

} // namespace gw
