#include "CPosedLines.h"

#include "BoneMeshQueries.h"
#include "CBoneMesh.h"
#include "Skeleton.h"
#include "UprightPoint.h"

#include <cmath>

namespace gw {

namespace {

constexpr LineColor kMarkedMesh = kHighlightColor;
constexpr float kAxisShare = 0.1f; // of the radius of the motion's bound

bool IsFinite(const Vec3& v)
{
    return std::isfinite(v.x) && std::isfinite(v.y) && std::isfinite(v.z);
}

} // namespace

CPosedLines::CPosedLines(const PictureMotion& motion, const PictureStyle& style, bool hasAxes)
    : motion_(motion), style_(style), m_bAxes(hasAxes)
{
    if (!motion.root)
        return;
    for (const CNode* node : NodesOf(*motion.root))
        m_kNodes.push_back(node);
}

EPictureSide CPosedLines::SideOf(const CNode* node) const
{
    const auto found = motion_.sides.find(node);
    return found == motion_.sides.end() ? EPictureSide::Middle : found->second;
}

LineColor CPosedLines::ColorOf(EPictureSide side) const
{
    if (side == EPictureSide::Left)
        return style_.left;
    return side == EPictureSide::Right ? style_.right : style_.bone;
}

void CPosedLines::Add(std::vector<PosedLine>& lines, const Vec3& from, const Vec3& to, LineColor color,
                      bool isBone) const
{
    if (IsFinite(from) && IsFinite(to))
        lines.push_back({UprightPoint(from, motion_.up), UprightPoint(to, motion_.up), color, isBone});
}

void CPosedLines::AddBones(std::vector<PosedLine>& lines) const
{
    for (const CNode* node : m_kNodes)
    {
        const CNode* const parent = node->GetParentNode();
        const Vec3 place = node->m_kWorldMatrix.Translation();
        const bool isDrawn = node != motion_.root.Get() && parent && SideOf(parent) != EPictureSide::Hidden;
        if (isDrawn)
            Add(lines, parent->m_kWorldMatrix.Translation(), place, ColorOf(SideOf(parent)), true);
        const CBoneMesh* const mesh = FindBoneMesh(*node);
        if (mesh && mesh->m_fLength > 0.0f && node->HasNoNodeChild())
            Add(lines, place,
                TransformCoord(mesh->Axis() * mesh->m_fLength, mesh->m_kMatrix * node->m_kWorldMatrix),
                ColorOf(SideOf(node)), true);
    }
}

void CPosedLines::AddMeshes(std::vector<PosedLine>& lines, const std::string& highlight)
{
    CDrawList list;
    std::vector<Ref<CTriMesh>> meshes;
    for (const Ref<CTriMesh>& mesh : m_kMeshes.Of(*motion_.root))
    {
        if (!RecordCast<CBoneMesh>(mesh.Get()))
            meshes.push_back(mesh);
    }
    BuildDrawList(list, meshes, 0.0f, highlight);
    for (size_t i = 0; i + 1 < list.Ends().size(); i += 2)
    {
        const LineEnd& end = list.Ends()[i];
        if (end.color == kBoneColor || end.color == kHighlightColor)
            Add(lines, end.point, list.Ends()[i + 1].point,
                end.color == kBoneColor ? style_.soft : kMarkedMesh, false);
    }
}

void CPosedLines::AddAxes(std::vector<PosedLine>& lines, float size) const
{
    for (const CNode* node : m_kNodes)
    {
        if (SideOf(node) == EPictureSide::Hidden)
            continue;
        const Mat4& world = NodeBoneWorld(*node); // the axes that rows of bone maps name
        const Vec3 origin = world.Translation();
        for (int axis = 0; axis < 3; ++axis)
            Add(lines, origin, origin + Vec3Normalized(world.Row(axis)) * size, kAxisColors[axis], false);
    }
}

std::vector<PosedLine> CPosedLines::Lines(const std::string& highlight)
{
    std::vector<PosedLine> lines;
    if (!motion_.root)
        return lines;
    AddMeshes(lines, highlight);
    AddBones(lines);
    if (m_bAxes)
        AddAxes(lines, motion_.root->m_kBound.m_fRadius * kAxisShare);
    return lines;
}

} // namespace gw
