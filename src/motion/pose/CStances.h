#pragma once

#include "Mat3.h"
#include "Mat4.h"
#include "Vec3.h"

#include <cstddef>
#include <unordered_map>
#include <vector>

namespace gw {

class CNode;

/// The joint positions of a skeleton in its rest pose and in some frames spread over its motion. Many files
/// have rest poses that are not standing poses, so a body is judged in several poses. A joint is posed in the
/// frames when it is first asked for, and the tree is restored. Do not change the tree in between.
class CStances
{
public:
    explicit CStances(CNode& root);

    /// Returns the joints, depth first.
    const std::vector<CNode*>& Joints() const { return m_kJoints; }
    /// Returns the index of a joint; -1 for null or a joint of another tree.
    int IndexOf(const CNode* joint) const;

    /// Returns the number of poses. The first one is the rest pose.
    size_t Count() const { return m_kTimes.size() + 1; }
    /// Returns the position of a joint in a pose, world space.
    Vec3 Place(size_t stance, int joint) const { return World(stance, joint).Translation(); }
    /// Returns the end of an end joint's bone, or the joint's position if the end is unknown.
    Vec3 Tip(size_t stance, int joint) const
    {
        return TransformCoord(m_kLocalTips[static_cast<size_t>(joint)], World(stance, joint));
    }
    /// Returns the rotation of a joint in a pose, from its own space to world space.
    Mat3 Turn(size_t stance, int joint) const { return NormalizedRows(World(stance, joint)); }

private:
    const Mat4& World(size_t stance, int joint) const;
    void PoseInFrames(CNode& node) const;

    std::vector<CNode*> m_kJoints;
    std::unordered_map<const CNode*, int> m_kIndex;
    std::vector<Vec3> m_kLocalTips; // in the joint's space
    std::vector<Mat4> m_kRest;      // world matrix of each joint
    std::vector<float> m_kTimes;    // of the frames
    // World matrices of each joint in the frames; empty if it was not asked for, such as nearly all fingers.
    mutable std::vector<std::vector<Mat4>> m_kInFrames;
};

} // namespace gw
