#pragma once

#include <cstdint>
#include <string>
#include <vector>

namespace gw {

/// What an alignment corrects in a motion.
enum class ECorrection : uint8_t
{
    RestPose,         ///< a bone that is off its direction in a T-pose, by `degrees`
    UpAxis,           ///< an up axis that is not Y; `joint` is its name: "Z", "-Y"
    BoneFrames,       ///< a frame that a slanted offset turns about its bone, by `degrees`
    DoubledPositions, ///< positions that repeat the joint's offset, which doubles its bone
};

/// One thing that an alignment corrects.
struct Correction
{
    ECorrection kind;
    std::string joint;
    double degrees = 0.0;
};

/// What an alignment corrects in one motion.
struct Corrections
{
    std::vector<Correction> list;
    /// The frame whose pose shows how the bones are turned, or -1 if the zero pose does.
    int referenceFrame = -1;
};

} // namespace gw
