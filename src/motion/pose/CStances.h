#pragma once

#include "CTreePoser.h"
#include "Mat3.h"
#include "Vec3.h"

#include <cstddef>
#include <optional>
#include <vector>

namespace gw {

class CNode;

/// Where all joints of a skeleton are in its rest pose and in some frames spread over its motion. Many files
/// have rest poses in which nobody could stand, so that what a body looks like is judged over several poses.
/// The tree is posed meanwhile and left as it was.
class CStances
{
public:
    explicit CStances(CNode& root);

    /// The joints, depth first.
    const std::vector<CNode*>& Joints() const { return tree_->Joints(); }
    /// The index of a joint; -1 for null and for one of another tree.
    int IndexOf(const CNode* joint) const { return tree_->IndexOf(joint); }

    /// The number of poses. The first one is the rest pose.
    size_t Count() const { return m_kPlaces.size(); }
    /// The place of a joint in a pose, world space.
    const Vec3& Place(size_t stance, int joint) const
    {
        return m_kPlaces[stance][static_cast<size_t>(joint)];
    }
    /// Where the bone of an end joint ends; the joint's own place where that is not known.
    const Vec3& Tip(size_t stance, int joint) const { return m_kTips[stance][static_cast<size_t>(joint)]; }

    /// The rotation of a joint in a pose, from its own space to the world.
    const Mat3& Turn(size_t stance, int joint) const { return m_kTurns[stance][static_cast<size_t>(joint)]; }

private:
    using Places = std::vector<Vec3>;

    void AddPose();

    std::optional<CTreePoser> tree_;
    Places m_kLocalTips; // in the joint's space
    std::vector<Places> m_kPlaces;
    std::vector<Places> m_kTips;
    std::vector<std::vector<Mat3>> m_kTurns;
};

} // namespace gw
