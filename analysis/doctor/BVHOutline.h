#pragma once

#include "Vec3.h"

#include <cstddef>
#include <cstdint>
#include <limits>
#include <string>
#include <vector>

namespace gw {

/// A joint of the hierarchy as the text has it. End sites are none.
struct OutlineJoint
{
    static constexpr size_t kNoParent = std::numeric_limits<size_t>::max();
    static constexpr int kNoChannel = -1;

    std::string name;
    size_t parent = kNoParent; ///< index of a joint before it
    size_t line = 0;           ///< where it is named
    size_t offsetLine = 0;
    Vec3 offset = kVec3Zero;
    std::vector<int> channels; ///< indices of kChannelNames, or kNoChannel for an unknown name
    size_t firstColumn = 0;    ///< of its channels in a row
};

/// What the text of a BVH file says before its rows, as far as it can be understood.
struct BVHOutline
{
    std::vector<OutlineJoint> joints; ///< of the first root, in the order of the file
    size_t columnCount = 0;           ///< values that a row should have

    int32_t frameCount = 0;
    size_t framesLine = 0;
    size_t framesBegin = 0;  ///< where the number of frames stands in the text
    size_t framesLength = 0; ///< bytes of it
    size_t frameTimeLine = 0;
    size_t rowsBegin = 0; ///< where the rows begin in the text
    size_t rowsLine = 1;  ///< and the line of that
};

} // namespace gw
