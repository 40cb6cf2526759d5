#pragma once

#include "CControl.h"
#include "Mat4.h"

#include <span>
#include <vector>

namespace gw {

class CSpatial;

/// How much a bone moves one point.
struct CSkinInfluence
{
    uint32_t SkinID = 0;     ///< index of the point; one that the target does not have is kept and has no say
    float SkinWeight = 0.0f; ///< of any size; 0 has no say
};

/// One bone of a skin.
struct CSkinBoneRecord
{
    Watch<CSpatial> m_pkBone;
    Mat4 m_kOffset = kMat4Identity; ///< from the mesh's model space to the bone's
    std::vector<CSkinInfluence> m_kInfluences;
};

/// An influence that acts, as an update walks them: by point, for one point in the order of the bones.
struct CSkinPointRecord
{
    uint32_t point;
    uint32_t bone; ///< index of the bone
    float weight;
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
    /// Sorts the influences by point. To be run when bones or influences have changed.
    void RebuildSkinTables();

    const std::vector<CSkinBoneRecord>& Bones() const { return m_kBones; }

private:
    CSkinBoneRecord& RecordOf(CSpatial& bone, const Mat4& offset);
    uint32_t LiveBones() const;
    std::vector<Mat4> SkinMatrices(const Mat4& before) const;
    std::span<const CSkinPointRecord> TakeInfluences(size_t& next, uint32_t point) const;

    std::vector<CSkinBoneRecord> m_kBones; // in the order of the file or of their adding
    // No entry for points that no bone moves: many skins on one large mesh must not take its size each.
    std::vector<CSkinPointRecord> m_kPoints;
    uint32_t m_uiLiveBones = 0; // when m_kPoints was made
};

} // namespace gw
