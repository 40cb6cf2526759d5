#pragma once

#include "CPoseSampler.h"

#include <unordered_map>
#include <vector>

namespace gw {

/// All joints of a motion, depth first, with their world matrices in the rest pose or at a frame. Do not
/// change the tree while the poser is in use.
class CTreePoser
{
public:
    /// `joints` is NodesOf the tree's root.
    CTreePoser(std::vector<CNode*> joints, float frequency);

    const std::vector<CNode*>& Joints() const { return m_kJoints; }
    /// Returns the index of a joint in that list, or -1.
    int IndexOf(const CNode* joint) const;
    int ParentOf(size_t joint) const { return IndexOf(m_kJoints[joint]->GetParentNode()); }

    void PoseRest();
    void Pose(double frame) { m_kSampler.Pose(frame); }

private:
    std::vector<CNode*> m_kJoints;
    std::unordered_map<const CNode*, int> m_kIndex;
    CPoseSampler m_kSampler;
};

} // namespace gw
