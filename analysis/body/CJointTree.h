#pragma once

#include "CStances.h"

#include <vector>

namespace gw {

/// A skeleton as the shape of a tree: indices of joints, lengths of bones, poses. Names are not looked at.
/// Lengths are those of the rest pose or, where all of these are 0, of the first frame.
class CJointTree
{
public:
    static constexpr int kNone = -1;

    explicit CJointTree(CNode& root);

    const CStances& Stances() const { return m_kStances; }
    CNode* Node(int joint) const { return joint == kNone ? nullptr : m_kStances.Joints()[At(joint)]; }
    int IndexOf(const CNode* node) const { return m_kStances.IndexOf(node); }
    int Count() const { return static_cast<int>(m_kJoints.size()); }

    int Parent(int joint) const { return m_kJoints[At(joint)].parent; }
    const std::vector<int>& Children(int joint) const { return m_kJoints[At(joint)].children; }
    /// From the parent to a joint.
    double Length(int joint) const { return m_kJoints[At(joint)].length; }
    /// From an end joint to the end of its bone, 0 where there is none.
    double TipLength(int joint) const { return m_kJoints[At(joint)].tipLength; }
    /// The longest way from a joint's parent through the joint to an end of the tree.
    double Reach(int joint) const { return m_kJoints[At(joint)].reach; }
    /// The child with the longest reach, or kNone.
    int MainChild(int joint) const { return m_kJoints[At(joint)].mainChild; }

    /// A joint and its main children down to the end, at most `most` of them.
    std::vector<int> MainChain(int joint, size_t most) const;
    bool IsAtOrBelow(int joint, int ancestor) const;
    int CommonAncestor(int a, int b) const;
    /// The joints from below one to another that is below it; empty where it is not below.
    std::vector<int> WayDown(int top, int bottom) const;
    /// Whether a joint has one child alone, at its own place: the child does its work.
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
    std::vector<Joint> m_kJoints; // parents before their children
    double m_fNoLength = 0.0;     // bones up to here are none
};

} // namespace gw
