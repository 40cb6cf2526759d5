#pragma once

#include <cstdint>
#include <string>
#include <vector>

namespace gw {

/// The kinds of problems that an alignment corrects.
enum class ECorrection : uint8_t
{
    RestPose,         ///< a bone is off its T-pose direction by `degrees`
    UpAxis,           ///< the up axis is not Y; `joint` is the axis name, such as "Z" or "-Y"
    BoneFrames,       ///< a slanted offset twists the frame about its bone by `degrees`
    DoubledPositions, ///< positions repeat the joint's offset, which doubles its bone
};

/// One correction of a motion.
struct Correction
{
    ECorrection kind;
    std::string joint;
    double degrees = 0.0;
};

/// All corrections of one motion.
struct Corrections
{
    std::vector<Correction> list;
    /// The frame whose pose shows how the bones are oriented, or -1 if the zero pose does.
    int referenceFrame = -1;
};

} // namespace gw
