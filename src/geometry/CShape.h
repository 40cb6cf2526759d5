#pragma once

#include "CGeometry.h"

namespace gw {

/// A flat figure of a few points that tells whether a place in the world hits it.
class CShape : public CGeometry
{
public:
    static const CRTTI ms_kRTTI;

    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }

    /// By the world points; false for a shape that lacks them, as files may have it.
    virtual bool HitTest(const Vec3& worldPoint) = 0;
    /// The mean of the points, in model space; the origin for none.
    virtual void GetCenter(Vec3& center);
    /// The mean of the world points.
    virtual void GetWorldCenter(Vec3& center);
};

/// A line between two points. It is hit within 5 units beside it, ends not counted.
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

    float m_fRadius = 0.0f; ///< in world units, whatever the matrix
};

/// A convex outline of four points, seen along Z.
class CRectangle : public CShape
{
public:
    static const CRTTI ms_kRTTI;

    CRectangle() { SetPointCount(4); }
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override { return new CRectangle(*this); }
    /// A place on an edge misses.
    bool HitTest(const Vec3& worldPoint) override;
};

} // namespace gw
