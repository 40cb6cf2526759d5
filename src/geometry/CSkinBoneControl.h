#pragma once

#include "CControl.h"
#include "Mat4.h"
#include "Vec3.h"

#include <vector>

namespace gw {

class CGeometry;
class CSpatial;

/// Moves the points of its target, a geometry, with bones: each point is transformed by each of its bones and
/// the results are blended. The slower kind of skin, kept for files that use it.
class CSkinBoneControl : public CControl
{
public:
    /// The influence of one bone on a point.
    struct Entry
    {
        Watch<CSpatial> m_pkBone;
        /// the weights of a point should sum to 1; a remainder is not made up
        float m_fWeight = 0.0f;
        Mat4 m_kOffset = kMat4Identity; ///< from the mesh's model space to the bone's space
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
    /// Points without entries collapse to the origin. Returns false if it is inactive or its target is not a
    /// geometry.
    bool Update(float time) override;
    bool UpdateTransform(float) override { return false; }
    /// Switches to the nodes with the same names under a root. Entries of a bone without such a node are
    /// removed.
    bool Bind(CObject& root) override;
    /// Switches to the copies of the bones. Entries of a bone without a copy are removed.
    bool Rebind(const CCloneMap& map) override;

    /// Adds an influence before the others of its point.
    void AddInfluence(CSpatial& bone, uint32_t point, float weight, const Mat4& offset);

    /// Returns the points in ascending order of index, each once.
    const std::vector<Point>& Points() const { return m_kPoints; }

private:
    void SortPoints();
    Vec3 Blend(const Point& point, const Vec3& model) const;

    std::vector<Point> m_kPoints;
};

} // namespace gw
