#pragma once

#include "CKeyArray.h"
#include "Quat.h"
#include "Vec3.h"

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// Channel codes are indices of this table: positions, rotations and scales about or along X, Y, Z.
inline constexpr std::string_view kChannelNames[] = {"Xposition", "Yposition", "Zposition",
                                                     "Xrotation", "Yrotation", "Zrotation",
                                                     "Xscale",    "Yscale",    "Zscale"};
inline constexpr int kFirstRotation = 3; ///< codes below are positions
inline constexpr int kFirstScale = 6;    ///< codes from here on are read and have no effect

/// What a block of the hierarchy is.
enum class EJointKind : int
{
    Global, ///< stands above the file's root, made by the reader
    Root,
    Joint,
    EndSite, ///< gives the bone before it its length and makes no node
};

/// A block of the hierarchy with what the motion rows gave it. Lengths in units of the file.
struct TKBVHJoint
{
    EJointKind kind = EJointKind::Global;
    std::string name;
    Vec3 offset = kVec3Zero;
    std::vector<std::unique_ptr<TKBVHJoint>> children;
    std::vector<int> channels; ///< codes in the order of the file

    // One key a frame, made of the row's values as they are read; none for a joint without channels.
    std::vector<Quat> rotationKeys;
    CKeyArray<Vec3> positionKeys; ///< offset included

    bool MakesNode() const { return kind != EJointKind::EndSite; }
    TKBVHJoint& AddChild(EJointKind childKind)
    {
        children.push_back(std::make_unique<TKBVHJoint>());
        children.back()->kind = childKind;
        return *children.back();
    }
};

/// The parse context.
struct TKBVHFile
{
    std::unique_ptr<TKBVHJoint> root; ///< the Global record; of its children only the first one counts
    int frameCount = 0;
    float frameTime = 0.0f; ///< seconds
    size_t jointCount = 0;  ///< blocks of all kinds
    size_t nodeCount = 0;   ///< blocks that make a node
    int64_t rowsAsked = 0;  ///< frames of all motions in the file, of which there should be one

    /// The file's root joint, or null.
    TKBVHJoint* FirstRoot() const
    {
        return root && !root->children.empty() ? root->children[0].get() : nullptr;
    }
};

} // namespace gw
