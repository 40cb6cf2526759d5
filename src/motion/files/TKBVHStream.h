#pragma once

#include "CMotionFile.h"
#include "Mat3.h"

#include <string>
#include <string_view>

namespace gw {

struct BVHWriteRules;
struct TKBVHFile;
struct TKBVHJoint;

/// Returns the rotation from +Y, the axis of a bone mesh, to the only child of a BVH joint: about Z by the
/// offset's direction in the XY plane, then about Y by that in the XZ plane. The frame of a bone slightly off
/// -Y can thus be rotated about the bone by up to a quarter turn.
Mat3 BoneTurn(const Vec3& offset);

/// Biovision hierarchy files. Reading creates a tree with one node for each ROOT and JOINT. Positions are
/// added to the offset on every joint that has position channels, and a joint's rotations are applied in
/// channel order. Lengths stay in file units.
class TKBVHStream : public CMotionFile
{
public:
    TKBVHStream() = default;
    /// Shares the other's trees, for writing.
    explicit TKBVHStream(const CMotionFile& trees) : CMotionFile(trees) {}

    /// Fills motionRoot. Returns false, with the reason in Record(), if the file is not valid BVH.
    bool Load(const std::string& path) override;
    /// Writes motionRoot with its rest pose as offsets, rotations in the order Z, Y, X, and positions at the
    /// root. Omits the last frame of the motion, as it always has. Returns false without a motion or if the
    /// file cannot be written. Leaves the tree's controls switched on.
    virtual bool WriteFile(const std::string& path);
    /// Writes motionRoot completely, for readers that need the motion itself: all frames, true bone ends,
    /// rotations that are correct in gimbal lock, position channels on joints whose positions differ from
    /// their offsets, and the frame time with all its digits. Returns false as WriteFile does.
    bool WriteExact(const std::string& path);
    /// Gives a node the bone mesh that reaches to its joint's children; nothing if it has none.
    virtual void AddBoneShape(const TKBVHFile& file, const TKBVHJoint& joint, CNode& node);

private:
    bool ReadMotion(TKBVHFile& file);
    bool ReadFrameTime(TKBVHFile& file);
    bool ReadKeyword(std::string_view words, std::string_view& rest);
    bool ReadNumber(std::string_view words, std::string_view& number);

    bool BuildAnimatedTree(const TKBVHFile& file);
    void FillNode(const TKBVHFile& file, TKBVHJoint& joint, CNode& node);
    bool WriteWith(const std::string& path, const BVHWriteRules& rules);
};

} // namespace gw
