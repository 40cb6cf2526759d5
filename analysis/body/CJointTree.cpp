// Precomputes what the search by shape asks for again and again: lengths, the longest path below each joint,
// and the child on it. Joints are stored with parents before children, so one backward pass suffices.

#include "CJointTree.h"

#include "CNode.h"

#include <algorithm>

namespace gw {

namespace {

constexpr double kNoLengthShare = 1e-4; // of the total bone length

}

CJointTree::CJointTree(CNode& root) : m_kStances(root)
{
    const std::vector<CNode*>& nodes = m_kStances.Joints();
    m_kJoints.resize(nodes.size());
    for (int i = 0; i < Count(); ++i)
    {
        const int parent = IndexOf(nodes[At(i)]->GetParentNode());
        if (parent == kNone)
            continue;
        m_kJoints[At(i)].parent = parent;
        m_kJoints[At(i)].depth = m_kJoints[At(parent)].depth + 1;
        m_kJoints[At(parent)].children.push_back(i);
    }
    double total = MeasureLengths(0);
    if (total == 0.0 && m_kStances.Count() > 1)
        total = MeasureLengths(1);
    m_fNoLength = total * kNoLengthShare;
    MeasureReaches();
}

double CJointTree::MeasureLengths(size_t stance)
{
    double total = 0.0;
    for (int i = 1; i < Count(); ++i)
    {
        Joint& joint = m_kJoints[At(i)];
        joint.length = Vec3Length(m_kStances.Place(stance, i) - m_kStances.Place(stance, joint.parent));
        joint.tipLength = Vec3Length(m_kStances.Tip(stance, i) - m_kStances.Place(stance, i));
        total += joint.length;
    }
    return total;
}

void CJointTree::MeasureReaches()
{
    for (int i = Count() - 1; i >= 0; --i)
    {
        Joint& joint = m_kJoints[At(i)];
        joint.reach = joint.length + (joint.mainChild == kNone ? joint.tipLength : Reach(joint.mainChild));
        if (joint.parent == kNone)
            continue;
        int& main = m_kJoints[At(joint.parent)].mainChild;
        if (main == kNone || joint.reach >= Reach(main))
            main = i;
    }
}

std::vector<int> CJointTree::MainChain(int joint, size_t most) const
{
    std::vector<int> chain;
    for (; joint != kNone && chain.size() < most; joint = MainChild(joint))
        chain.push_back(joint);
    return chain;
}

bool CJointTree::IsAtOrBelow(int joint, int ancestor) const
{
    while (joint != kNone && joint != ancestor)
        joint = Parent(joint);
    return joint != kNone;
}

int CJointTree::CommonAncestor(int a, int b) const
{
    while (a != b)
    {
        int& deeper = m_kJoints[At(a)].depth >= m_kJoints[At(b)].depth ? a : b;
        deeper = Parent(deeper);
    }
    return a;
}

std::vector<int> CJointTree::WayDown(int top, int bottom) const
{
    std::vector<int> way;
    for (; bottom != kNone && bottom != top; bottom = Parent(bottom))
        way.push_back(bottom);
    if (bottom == kNone)
        return {};
    std::ranges::reverse(way);
    return way;
}

bool CJointTree::HasStandIn(int joint) const
{
    const std::vector<int>& children = Children(joint);
    return children.size() == 1 && Length(children.front()) <= m_fNoLength;
}

} // namespace gw
