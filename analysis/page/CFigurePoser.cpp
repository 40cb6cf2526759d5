#include "CFigurePoser.h"

#include "BoneMeshQueries.h"
#include "CBoneMesh.h"
#include "Skeleton.h"

#include <algorithm>
#include <cmath>

namespace gw {

namespace {

constexpr size_t kMostJoints = 1000; // enough for detailed hands and faces; more would only be a tangle

std::vector<CNode*> PathTo(CNode* node)
{
    std::vector<CNode*> path;
    for (; node; node = node->GetParentNode())
        path.push_back(node);
    std::ranges::reverse(path);
    return path;
}

// Returns the lowest node at or above all named ones.
CNode* CommonRoot(CNode* root, const std::vector<std::string>& bones)
{
    std::vector<CNode*> common;
    for (const std::string& name : bones)
    {
        const std::vector<CNode*> path = PathTo(FindNode(root, name.c_str()));
        if (path.empty())
            continue;
        if (common.empty())
            common = path;
        common.erase(std::ranges::mismatch(common, path).in1, common.end());
    }
    return common.empty() ? root : common.back();
}

bool IsFinite(const Vec3& v)
{
    return std::isfinite(v.x) && std::isfinite(v.y) && std::isfinite(v.z);
}

// Returns the end of a bone without an end joint.
std::optional<Vec3> FreeEnd(const CNode& node)
{
    const CBoneMesh* mesh = FindBoneMesh(node);
    if (!mesh || mesh->m_fLength <= 0.0f || !node.HasNoNodeChild())
        return std::nullopt;
    return TransformCoord(mesh->Axis() * mesh->m_fLength, mesh->m_kMatrix * node.m_kWorldMatrix);
}

// Returns the joints above the faulty bones, starting with the one that shows the fault.
std::vector<const CNode*> BadJoints(EFrameFault fault, const CNode* bone)
{
    if (!bone || fault != EFrameFault::KneePop)
        return {bone};
    const CNode* const knee = bone->GetParentNode();
    return {knee, knee ? knee->GetParentNode() : nullptr};
}

} // namespace

CFigurePoser::CFigurePoser(const MotionClip& clip, const std::vector<std::string>& bones)
    : m_pkTreeRoot(clip.root), m_pkRoot(CommonRoot(clip.root, bones)), m_kNodes(NodesOf(*m_pkRoot)),
      m_kSampler(clip.frequency)
{
    m_kNodes.resize(std::min(m_kNodes.size(), kMostJoints));
    for (CNode* node : m_kNodes)
        m_kSampler.Watch(node);
}

PosedFigure CFigurePoser::Pose(double frame, EFrameFault fault, const std::string& bone)
{
    m_kSampler.Pose(frame);
    const std::vector<const CNode*> bad = BadJoints(fault, FindNode(m_pkTreeRoot, bone.c_str()));
    PosedFigure figure;
    const auto addLine = [&](const CNode* joint, const Vec3& end) {
        const Vec3 start = joint->m_kWorldMatrix.Translation();
        if (IsFinite(start) && IsFinite(end))
            (std::ranges::count(bad, joint) ? figure.badLines : figure.lines).push_back({start, end});
    };
    for (const CNode* node : m_kNodes)
    {
        if (node != m_pkRoot)
            addLine(node->GetParentNode(), node->m_kWorldMatrix.Translation());
        if (const std::optional<Vec3> end = FreeEnd(*node))
            addLine(node, *end);
    }
    if (bad.front() && IsFinite(bad.front()->m_kWorldMatrix.Translation()))
        figure.badJoint = bad.front()->m_kWorldMatrix.Translation();
    figure.root = m_pkRoot->m_kWorldMatrix.Translation();
    return figure;
}

Vec3 CFigurePoser::Across(const std::string& rightThigh, const std::string& leftThigh) const
{
    const CNode* const right = FindNode(m_pkTreeRoot, rightThigh.c_str());
    const CNode* const left = FindNode(m_pkTreeRoot, leftThigh.c_str());
    if (!right || !left)
        return kVec3UnitX;
    Vec3 across = left->m_kWorldMatrix.Translation() - right->m_kWorldMatrix.Translation();
    across.y = 0.0f;
    across = Vec3Normalized(across);
    return IsFinite(across) && across != kVec3Zero ? across : kVec3UnitX;
}

} // namespace gw
