#pragma once

#include "CMotionFile.h"
#include "Mat3.h"

#include <string>
#include <string_view>

namespace gw {

struct BVHWriteRules;
struct TKBVHFile;
struct TKBVHJoint;

/// What turns +Y, the axis of a bone mesh, to where the only child of a BVH joint stands: about Z by the
/// offset's direction in the XY plane, about Y by that in the XZ plane. So the frame of a bone that slants
/// only a little from -Y is turned about the bone by up to a quarter turn.
Mat3 BoneTurn(const Vec3& offset);

/// Biovision hierarchy files. Reading makes a tree of nodes, one for each ROOT and JOINT; positions are added
/// to the offset on every joint that carries them, and the order of a joint's rotations is the order of its
/// channels. Lengths stay in units of the file.
class TKBVHStream : public CMotionFile
{
public:
    TKBVHStream() = default;
    /// Shares the other's trees, for writing.
    explicit TKBVHStream(const CMotionFile& trees) : CMotionFile(trees) {}

    /// Fills motionRoot. False, with the reason in Record(), for what is no BVH file.
    bool Load(const std::string& path) override;
    /// Writes motionRoot with its rest pose as offsets, rotations in the order Z, Y, X and positions at the
    /// root. The last frame of the motion is left out, as it has always been. False without a motion or when
    /// the file cannot be written. Leaves the tree's controls switched on.
    virtual bool WriteFile(const std::string& path);
    /// Writes motionRoot whole, for readers that take it for the motion itself: all frames, the ends of bones
    /// where they are, rotations also where two of their axes meet, position channels on the joints whose
    /// positions are not their offsets, and the frame time in all its digits. False as above.
    bool WriteExact(const std::string& path);
    /// Gives a node the bone mesh that reaches to its joint's children; none to a joint without any.
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
