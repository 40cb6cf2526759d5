#pragma once

#include "Vec3.h"

#include <cstddef>
#include <cstdint>
#include <limits>
#include <string>
#include <vector>

namespace gw {

/// A joint as written in the hierarchy. End sites are not included.
struct OutlineJoint
{
    static constexpr size_t kNoParent = std::numeric_limits<size_t>::max();
    static constexpr int kNoChannel = -1;

    std::string name;
    size_t parent = kNoParent; ///< index of an earlier joint
    size_t line = 0;           ///< line of its name
    size_t offsetLine = 0;
    Vec3 offset = kVec3Zero;
    std::vector<int> channels; ///< indices into kChannelNames, or kNoChannel for an unknown name
    size_t firstColumn = 0;    ///< first of its columns in a row
};

/// The text of a BVH file before its rows, as far as it can be understood.
struct BVHOutline
{
    std::vector<OutlineJoint> joints; ///< of the first root, in file order
    size_t columnCount = 0;           ///< number of values that a row should have

    int32_t frameCount = 0;
    size_t framesLine = 0;
    size_t framesBegin = 0;  ///< position of the frame count in the text
    size_t framesLength = 0; ///< its length in bytes
    size_t frameTimeLine = 0;
    size_t rowsBegin = 0; ///< position of the first row in the text
    size_t rowsLine = 1;  ///< line of the first row
};

} // namespace gw
