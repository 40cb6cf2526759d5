#pragma once

#include "CGeometry.h"

namespace gw {

/// A flat figure of a few points that can test whether a world position hits it.
class CShape : public CGeometry
{
public:
    static const CRTTI ms_kRTTI;

    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }

    /// Tests the world points; false for a shape without enough points, as files may have.
    virtual bool HitTest(const Vec3& worldPoint) = 0;
    /// Computes the mean of the points, in model space; the origin without points.
    virtual void GetCenter(Vec3& center);
    /// Computes the mean of the world points.
    virtual void GetWorldCenter(Vec3& center);
};

/// A line between two points. Positions within 5 units beside it hit, excluding its ends.
class CLine : public CShape
{
public:
    static const CRTTI ms_kRTTI;

    CLine() { SetPointCount(2); }
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override { return new CLine(*this); }
    bool HitTest(const Vec3& worldPoint) override;
};

/// A circle around one point.
class CCircle : public CShape
{
public:
    static const CRTTI ms_kRTTI;

    CCircle() { SetPointCount(1); }
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override { return new CCircle(*this); }
    void Fields(CFieldArchive& archive) override;
    uint64_t GetMemoryUsed() const override;
    bool HitTest(const Vec3& worldPoint) override;

    float m_fRadius = 0.0f; ///< in world units, regardless of the matrix
};

/// A convex quadrilateral seen along Z.
class CRectangle : public CShape
{
public:
    static const CRTTI ms_kRTTI;

    CRectangle() { SetPointCount(4); }
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override { return new CRectangle(*this); }
    /// A position on an edge does not hit.
    bool HitTest(const Vec3& worldPoint) override;
};

} // namespace gw
