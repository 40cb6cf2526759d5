#pragma once

#include "CControl.h"
#include "Mat4.h"

#include <span>
#include <vector>

namespace gw {

class CSpatial;

/// How much a bone moves one point.
struct SkinInfluence
{
    uint32_t SkinID = 0;     ///< index of the point; one that the target does not have is kept and has no say
    float SkinWeight = 0.0f; ///< of any size; 0 has no say
};

/// One bone of a skin.
struct CSkinBoneRecord
{
    Watch<CSpatial> m_pkBone;
    Mat4 m_kOffset = kMat4Identity; ///< from the mesh's model space to the bone's
    std::vector<SkinInfluence> m_kInfluences;
};

/// What moves one point: its bones, in the order of the bone table, and as many weights, none of them 0. A
/// view of lists that all points of the skin share: lists of its own would take several times the memory.
struct CSkinPointRecord
{
    uint32_t point;
    std::span<CSpatial* const> bones;
    std::span<const float> weights;
    std::span<const uint32_t> places; ///< of the bones in the bone table
};

/// Points from `begin` up to `end` with the same number of influences. A group is kept as runs of points, so
/// that many skins on one large mesh do not take its size each.
struct SkinPointRun
{
    uint32_t begin;
    uint32_t end;
    size_t record; ///< of the first point in the point table; not used for points without influences
};

/// Moves the points of its target, a geometry, with bones. Matrices are blended and each point is transformed
/// once. What the weights of a point lack up to 1 goes to the mesh's own matrix.
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
    /// Points that no bone moves go with the mesh. False where it is off or its target is no geometry.
    bool Update(float time) override;
    bool UpdateTransform(float) override { return false; }
    /// Goes over to the nodes of the same names under a root. A bone that has none is gone with its
    /// influences.
    bool Bind(CObject& root) override;
    /// Goes over to the copies of the bones; a bone without a copy is gone with its influences.
    bool Rebind(const CCloneMap& map) override;

    /// A new bone comes with this offset; a known one keeps its own. To be followed by RebuildSkinTables.
    void AddInfluence(CSpatial& bone, uint32_t point, float weight, const Mat4& offset);
    /// Makes the point table and the group table for the target's points. Must run when influences have
    /// changed; an update notices by itself when bones or the number of points have.
    void RebuildSkinTables();

    const std::vector<CSkinBoneRecord>& Bones() const { return m_kBones; }
    /// The points that bones move, in ascending order. Valid until the next rebuild.
    const std::vector<CSkinPointRecord>& Points() const { return m_kPoints; }
    /// Row g has the points with exactly g influences, in ascending order; row 0 those that no bone moves.
    /// There is one row more than the most influences of any point.
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

    std::vector<CSkinBoneRecord> m_kBones; // in the order of the file or of their adding

    // Derived from the bones and the number of points below. A copy starts without them and makes its own.
    std::vector<CSkinPointRecord> m_kPoints;
    std::vector<std::vector<SkinPointRun>> m_kGroups;
    std::vector<CSpatial*> m_kPointBones;
    std::vector<float> m_kPointWeights;
    std::vector<uint32_t> m_kPointPlaces;
    std::vector<CSpatial*> m_kTableBones; // of the bone table then; null for one that had died
    size_t m_uiTablePoints = 0;
};

} // namespace gw
