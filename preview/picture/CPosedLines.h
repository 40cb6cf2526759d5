#pragma once

#include "CDrawList.h"
#include "CMeshList.h"
#include "CNode.h"
#include "PictureMotion.h"
#include "PictureStyle.h"

#include <vector>

namespace gw {

/// A line of a posed motion, in world space with y up.
struct PosedLine
{
    Vec3 from;
    Vec3 to;
    LineColor color;
    bool isBone = false; ///< thick, with a shadow on the floor
};

/// The lines of a motion in its current pose: one per bone, and the outlines of meshes other than bone
/// meshes.
class CPosedLines
{
public:
    CPosedLines(const PictureMotion& motion, const PictureStyle& style, bool hasAxes);

    /// `highlight` is the name of a bone whose meshes get another color.
    std::vector<PosedLine> Lines(const std::string& highlight);

private:
    void AddBones(std::vector<PosedLine>& lines) const;
    void AddMeshes(std::vector<PosedLine>& lines, const std::string& highlight);
    void AddAxes(std::vector<PosedLine>& lines, float size) const;
    void Add(std::vector<PosedLine>& lines, const Vec3& from, const Vec3& to, LineColor color,
             bool isBone) const;
    EPictureSide SideOf(const CNode* node) const;
    LineColor ColorOf(EPictureSide side) const;

    const PictureMotion& motion_;
    const PictureStyle& style_;
    bool m_bAxes;
    std::vector<const CNode*> m_kNodes; ///< parents before children
    CMeshList m_kMeshes;
};

} // namespace gw
