#pragma once

#include "CControl.h"
#include "Mat4.h"

#include <span>
#include <vector>

namespace gw {

class CSpatial;

/// The influence of a bone on one point.
struct SkinInfluence
{
    uint32_t SkinID = 0;     ///< index of the point; kept but ignored if the target has no such point
    float SkinWeight = 0.0f; ///< any number; 0 is ignored
};

/// One bone of a skin.
struct CSkinBoneRecord
{
    Watch<CSpatial> m_pkBone;
    Mat4 m_kOffset = kMat4Identity; ///< from the mesh's model space to the bone's space
    std::vector<SkinInfluence> m_kInfluences;
};

/// The bones that move one point, in the order of the bone table, and their nonzero weights. A view into
/// lists that all points of the skin share, because separate lists would take several times the memory.
struct CSkinPointRecord
{
    uint32_t point;
    std::span<CSpatial* const> bones;
    std::span<const float> weights;
    std::span<const uint32_t> places; ///< indices of the bones in the bone table
};

/// Points from `begin` up to `end` with the same number of influences. Groups are stored as runs of points,
/// so that many skins on one large mesh do not each take memory for all its points.
struct SkinPointRun
{
    uint32_t begin;
    uint32_t end;
    size_t record; ///< of the first point in the point table; not used for points without influences
};

/// Moves the points of its target, a geometry, with bones. Matrices are blended and each point is transformed
/// once. The remainder of a point's weights up to 1 goes to the mesh's own matrix.
class CBoneSkinControl : public CControl
{
public:
    static const CRTTI ms_kRTTI;

    CBoneSkinControl();
    CBoneSkinControl(const CBoneSkinControl& source);
    ~CBoneSkinControl() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override;
    void Fields(CFieldArchive& archive) override;
    void Link(COrrinStream& stream, CLinkRecord& record) override;
    uint64_t GetMemoryUsed() const override;
    /// Points without bones move with the mesh. Returns false if it is inactive or its target is not a
    /// geometry.
    bool Update(float time) override;
    bool UpdateTransform(float) override { return false; }
    /// Switches to the nodes with the same names under a root. A bone without such a node is removed with its
    /// influences.
    bool Bind(CObject& root) override;
    /// Switches to the copies of the bones. A bone without a copy is removed with its influences.
    bool Rebind(const CCloneMap& map) override;

    /// Adds an influence. A new bone gets this offset; a known one keeps its own. Call RebuildSkinTables
    /// afterwards.
    void AddInfluence(CSpatial& bone, uint32_t point, float weight, const Mat4& offset);
    /// Builds the point and group tables for the target's points. Call it after influences change; Update
    /// detects changes of the bones or the number of points by itself.
    void RebuildSkinTables();

    const std::vector<CSkinBoneRecord>& Bones() const { return m_kBones; }
    /// Returns the points that bones move, in ascending order. Valid until the next rebuild.
    const std::vector<CSkinPointRecord>& Points() const { return m_kPoints; }
    /// Returns the groups: row g contains the points with exactly g influences, in ascending order; row 0
    /// those without bones. The number of rows is the largest influence count plus one.
    const std::vector<std::vector<SkinPointRun>>& Groups() const { return m_kGroups; }

private:
    struct Influence
    {
        uint32_t point;
        uint32_t place;
        float weight;
    };

    CSkinBoneRecord& RecordOf(CSpatial& bone, const Mat4& offset);
    std::vector<CSpatial*> CurrentBones() const;
    std::vector<Influence> SortedInfluences() const;
    void AddToGroup(size_t influences, uint32_t begin, uint32_t end);
    bool AreTablesCurrent(size_t pointCount) const;
    std::vector<Mat4> SkinMatrices(const Mat4& before) const;

    std::vector<CSkinBoneRecord> m_kBones; // in the order of the file or of their addition

    // Derived from the bones and the number of points. A copy starts without them and builds its own.
    std::vector<CSkinPointRecord> m_kPoints;
    std::vector<std::vector<SkinPointRun>> m_kGroups;
    std::vector<CSpatial*> m_kPointBones;
    std::vector<float> m_kPointWeights;
    std::vector<uint32_t> m_kPointPlaces;
    // the bone table when the tables were built; null for a deleted bone
    std::vector<CSpatial*> m_kTableBones;
    size_t m_uiTablePoints = 0;
};

} // namespace gw
