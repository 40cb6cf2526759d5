#pragma once

#include <cstdint>
#include <string>
#include <vector>

namespace gw {

/// What stands against the rules in a motion, and an alignment mends.
enum class EAlignNeed : uint8_t
{
    RestPose,         ///< a bone does not lie where a T-pose has it; `degrees` from there
    UpAxis,           ///< the motion's up axis is not Y; `joint` is its name: "Z", "-Y"
    BoneFrames,       ///< a slanted offset turns the bone's frame about the bone; `degrees` by which
    DoubledPositions, ///< positions repeat the joint's offset, so that its bone comes out doubled
};

/// One thing that an alignment mends.
struct AlignFinding
{
    EAlignNeed need;
    std::string joint;
    double degrees = 0.0;
};

/// What an alignment found in a motion.
struct AlignReport
{
    std::vector<AlignFinding> findings;
    /// The frame whose pose tells how the bones are turned, or -1 where the zero pose does.
    int referenceFrame = -1;
};

} // namespace gw
