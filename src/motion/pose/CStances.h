#pragma once

#include "CTreePoser.h"
#include "Mat3.h"
#include "Vec3.h"

#include <cstddef>
#include <optional>
#include <vector>

namespace gw {

class CNode;

/// The joint positions of a skeleton in its rest pose and in some frames spread over its motion. Many files
/// have rest poses that are not standing poses, so a body is judged in several poses. The constructor poses
/// the tree and restores it.
class CStances
{
public:
    explicit CStances(CNode& root);

    /// Returns the joints, depth first.
    const std::vector<CNode*>& Joints() const { return tree_->Joints(); }
    /// Returns the index of a joint; -1 for null or a joint of another tree.
    int IndexOf(const CNode* joint) const { return tree_->IndexOf(joint); }

    /// Returns the number of poses. The first one is the rest pose.
    size_t Count() const { return m_kPlaces.size(); }
    /// Returns the position of a joint in a pose, world space.
    const Vec3& Place(size_t stance, int joint) const
    {
        return m_kPlaces[stance][static_cast<size_t>(joint)];
    }
    /// Returns the end of an end joint's bone, or the joint's position if the end is unknown.
    const Vec3& Tip(size_t stance, int joint) const { return m_kTips[stance][static_cast<size_t>(joint)]; }

    /// Returns the rotation of a joint in a pose, from its own space to world space.
    Mat3 Turn(size_t stance, int joint) const;

private:
    using Places = std::vector<Vec3>;

    void AddPose();

    std::optional<CTreePoser> tree_;
    Places m_kLocalTips; // in the joint's space
    std::vector<Places> m_kPlaces;
    std::vector<Places> m_kTips;
    std::vector<std::vector<Mat3>> m_kAxes; // with the scale: Turn is rarely asked
};

} // namespace gw
