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

/// Channel codes are indices of this table: positions, rotations and scales along or about X, Y, Z.
inline constexpr std::string_view kChannelNames[] = {"Xposition", "Yposition", "Zposition",
                                                     "Xrotation", "Yrotation", "Zrotation",
                                                     "Xscale",    "Yscale",    "Zscale"};
inline constexpr int kFirstRotation = 3; ///< codes below are positions
inline constexpr int kFirstScale = 6;    ///< from here on: read, without effect

/// The kind of a hierarchy block.
enum class EJointKind : int
{
    Global, ///< above the file's root, created by the reader
    Root,
    Joint,
    EndSite, ///< determines the length of the bone before it, creates no node
};

/// A hierarchy block with the keys from the motion rows. Lengths are in file units.
struct TKBVHJoint
{
    EJointKind kind = EJointKind::Global;
    std::string name;
    Vec3 offset = kVec3Zero;
    std::vector<std::unique_ptr<TKBVHJoint>> children;
    std::vector<int> channels; ///< codes in file order

    // One key per frame, created as rows are read; empty for a joint without channels.
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

/// The parsed file.
struct TKBVHFile
{
    std::unique_ptr<TKBVHJoint> root; ///< the Global record; only its first child is used
    int frameCount = 0;
    float frameTime = 0.0f; ///< seconds
    size_t jointCount = 0;  ///< blocks of all kinds
    size_t nodeCount = 0;   ///< blocks that create a node
    int64_t rowsAsked = 0;  ///< frames of all motions in the file, which should contain one

    /// Returns the file's root joint, or null.
    TKBVHJoint* FirstRoot() const
    {
        return root && !root->children.empty() ? root->children[0].get() : nullptr;
    }
};

} // namespace gw
