#pragma once

#include <cstdint>
#include <string>
#include <vector>

namespace gw {

/// A problem of a motion that an alignment corrects.
enum class EAlignNeed : uint8_t
{
    RestPose,         ///< a bone is not where a T-pose has it; off by `degrees`
    UpAxis,           ///< the motion's up axis is not Y; `joint` is its name: "Z", "-Y"
    BoneFrames,       ///< a slanted offset twists the bone's frame by `degrees`
    DoubledPositions, ///< positions repeat the joint's offset, which doubles the bone
};

/// One problem that an alignment corrects.
struct AlignFinding
{
    EAlignNeed need;
    std::string joint;
    double degrees = 0.0;
};

/// The findings of an alignment.
struct AlignReport
{
    std::vector<AlignFinding> findings;
    /// The frame whose pose defines the bones' rotations, or -1 for the zero pose.
    int referenceFrame = -1;
};

} // namespace gw
