#pragma once

#include "CControl.h"
#include "Mat4.h"
#include "Vec3.h"

#include <vector>

namespace gw {

class CGeometry;
class CSpatial;

/// Moves the points of its target, a geometry, with bones, point by point: a point goes with each of its
/// bones and the places are blended. The slower kind of skin, kept for files that use it.
class CSkinBoneControl : public CControl
{
public:
    /// How one bone moves a point.
    struct Entry
    {
        Watch<CSpatial> m_pkBone;
        float m_fWeight = 0.0f;         ///< those of a point are to sum to 1; nothing makes up for it
        Mat4 m_kOffset = kMat4Identity; ///< from the mesh's model space to the bone's
    };
    struct Point
    {
        uint32_t m_uiIndex = 0;
        std::vector<Entry> m_kEntries;
    };

    static const CRTTI ms_kRTTI;

    CSkinBoneControl();
    CSkinBoneControl(const CSkinBoneControl& source);
    ~CSkinBoneControl() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override;
    void Fields(CFieldArchive& archive) override;
    void Link(COrrinStream& stream, CLinkRecord& record) override;
    uint64_t GetMemoryUsed() const override;
    /// A point without an entry collapses to the origin. False where it is off or its target is no geometry.
    bool Update(float time) override;
    bool UpdateTransform(float) override { return false; }
    /// Goes over to the nodes of the same names under a root. Entries of a bone that has none are gone.
    bool Bind(CObject& root) override;
    /// Goes over to the copies of the bones; entries of a bone without a copy are gone.
    bool Rebind(const CCloneMap& map) override;

    /// Adds an influence in front of the others of its point.
    void AddInfluence(CSpatial& bone, uint32_t point, float weight, const Mat4& offset);

    /// In ascending order of their indices, each once.
    const std::vector<Point>& Points() const { return m_kPoints; }

private:
    void SortPoints();
    Vec3 Blend(const Point& point, const Vec3& model) const;

    std::vector<Point> m_kPoints;
};

} // namespace gw
