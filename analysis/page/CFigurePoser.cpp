#include "CFigurePoser.h"

#include "BoneMeshQueries.h"
#include "CBoneMesh.h"
#include "Skeleton.h"

#include <algorithm>
#include <cmath>
#include <unordered_map>

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
CNode* CommonRoot(CNode* root, const std::vector<BoneMeasures>& bones, std::string BoneMeasures::*name)
{
    std::vector<CNode*> common;
    for (const BoneMeasures& bone : bones)
    {
        const std::vector<CNode*> path = PathTo(FindNode(root, (bone.*name).c_str()));
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
Vec3 FreeEnd(const CNode& node)
{
    const CBoneMesh* const mesh = FindBoneMesh(node);
    return TransformCoord(mesh->Axis() * mesh->m_fLength, mesh->m_kMatrix * node.m_kWorldMatrix);
}

bool HasFreeEnd(const CNode& node)
{
    const CBoneMesh* const mesh = FindBoneMesh(node);
    return mesh && mesh->m_fLength > 0.0f && node.HasNoNodeChild();
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

CFigurePoser::CFigurePoser(const MotionClip& clip, const std::vector<BoneMeasures>& bones,
                           std::string BoneMeasures::*name)
    : m_pkTreeRoot(clip.root), m_pkRoot(CommonRoot(clip.root, bones, name)), m_kNodes(NodesOf(*m_pkRoot)),
      m_kSampler(clip.frequency)
{
    m_kNodes.resize(std::min(m_kNodes.size(), kMostJoints));
    const std::vector<EFigureSide> sides = FigureSides(m_kNodes, bones, name);
    std::unordered_map<const CNode*, size_t> indices;
    for (CNode* node : m_kNodes)
    {
        m_kSampler.Watch(node);
        const size_t index = indices.size();
        indices[node] = index;
        if (node != m_pkRoot)
            m_kBones.push_back(
                {indices[node->GetParentNode()], index, sides[indices[node->GetParentNode()]]});
    }
    for (size_t i = 0; i < m_kNodes.size(); ++i)
    {
        if (!HasFreeEnd(*m_kNodes[i]))
            continue;
        m_kBones.push_back({i, m_kNodes.size() + m_kTips.size(), sides[i]});
        m_kTips.push_back(m_kNodes[i]);
    }
}

std::vector<Vec3> CFigurePoser::CurrentPoints() const
{
    std::vector<Vec3> points;
    points.reserve(m_kNodes.size() + m_kTips.size());
    for (const CNode* node : m_kNodes)
        points.push_back(node->m_kWorldMatrix.Translation());
    for (const CNode* node : m_kTips)
        points.push_back(FreeEnd(*node));
    return points;
}

std::vector<Vec3> CFigurePoser::Points(double frame)
{
    m_kSampler.Pose(frame);
    return CurrentPoints();
}

PosedFigure CFigurePoser::Pose(double frame, EFrameFault fault, const std::string& bone)
{
    const std::vector<Vec3> points = Points(frame);
    const std::vector<const CNode*> bad = BadJoints(fault, FindNode(m_pkTreeRoot, bone.c_str()));
    PosedFigure figure;
    for (const FigureBone& line : m_kBones)
    {
        const std::array ends{points[line.from], points[line.to]};
        if (IsFinite(ends[0]) && IsFinite(ends[1]))
            (std::ranges::count(bad, m_kNodes[line.from]) ? figure.badLines : figure.lines)
                .push_back({ends, line.side});
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
