#pragma once

#include "Alignment.h"
#include "CNode.h"

#include <cstdint>
#include <vector>

namespace gw {

/// A motion told from another rest pose.
struct AlignedMotion
{
    Ref<CNode> root;
    std::vector<CNode*> joints; ///< as those of the alignment, in its order
};

/// Which joints of an aligned motion move.
enum class EAlignedJoints : uint8_t
{
    All,
    Body, ///< those of the body and what bears them; fingers and faces keep to their rest pose
};

/// Tells a motion from the rest pose of its alignment, as a tree of its own: a track and a bone mesh for each
/// joint, whose world positions are those of the source at every frame, turned so that Y is up. Bones of the
/// body have the frames that the target's have at rest. Positions stand in a track only where they change.
AlignedMotion AlignMotion(const BodyMotion& motion, const Alignment& alignment,
                          EAlignedJoints joints = EAlignedJoints::All);

} // namespace gw
