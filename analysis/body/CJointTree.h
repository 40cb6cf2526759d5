#pragma once

#include "CStances.h"

#include <vector>

namespace gw {

/// A skeleton as the shape of a tree: joint indices, bone lengths, poses. Names are ignored. Lengths are from
/// the rest pose or, if all of these are 0, from the first frame.
class CJointTree
{
public:
    static constexpr int kNone = -1;

    /// Examines the rest pose and some frames of a skeleton, which must outlive the object. Restores its
    /// pose.
    explicit CJointTree(CNode& root);

    const CStances& Stances() const { return m_kStances; }
    /// Returns the node of a joint; null for kNone.
    CNode* Node(int joint) const { return joint == kNone ? nullptr : m_kStances.Joints()[At(joint)]; }
    int IndexOf(const CNode* node) const { return m_kStances.IndexOf(node); }
    int Count() const { return static_cast<int>(m_kJoints.size()); }

    int Parent(int joint) const { return m_kJoints[At(joint)].parent; }
    const std::vector<int>& Children(int joint) const { return m_kJoints[At(joint)].children; }
    /// Returns the distance from a joint's parent to the joint.
    double Length(int joint) const { return m_kJoints[At(joint)].length; }
    /// Returns the length of an end joint's bone, or 0.
    double TipLength(int joint) const { return m_kJoints[At(joint)].tipLength; }
    /// Returns the longest path from a joint's parent through the joint to an end of the tree.
    double Reach(int joint) const { return m_kJoints[At(joint)].reach; }
    /// Returns the child with the longest reach, or kNone.
    int MainChild(int joint) const { return m_kJoints[At(joint)].mainChild; }

    /// Returns a joint and its main children down to the end, at most `most` of them.
    std::vector<int> MainChain(int joint, size_t most) const;
    bool IsAtOrBelow(int joint, int ancestor) const;
    /// Returns the lowest joint that has both joints at or below it.
    int CommonAncestor(int a, int b) const;
    /// Returns the joints on the path from one joint (excluded) down to another; empty if that is not below.
    std::vector<int> WayDown(int top, int bottom) const;
    /// Returns whether a joint's only child is at the joint's own place and replaces it.
    bool HasStandIn(int joint) const;

private:
    struct Joint
    {
        int parent = kNone;
        int depth = 0;
        std::vector<int> children;
        double length = 0.0;
        double tipLength = 0.0;
        double reach = 0.0;
        int mainChild = kNone;
    };

    static size_t At(int joint) { return static_cast<size_t>(joint); }
    double MeasureLengths(size_t stance);
    void MeasureReaches();

    CStances m_kStances;
    std::vector<Joint> m_kJoints; // parents before children
    double m_fNoLength = 0.0;     // shorter bones count as having no length
};

} // namespace gw
