#pragma once

#include "CTriMesh.h"

namespace gw {

/// A small solid of fixed shape that displays a bone, scaled to the bone's length and attached to the bone's
/// node. In a file it is a triangle mesh under its own class name, which cannot be read back; its clone is a
/// plain CTriMesh.
class CBoneMesh : public CTriMesh
{
public:
    static const CRTTI ms_kRTTI;

    CBoneMesh() { m_bBoneMesh = true; }
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }

    /// Builds the shape with a length. If the length is not positive, returns false and changes nothing.
    virtual bool Build(float length) = 0;
    /// Returns the direction of the bone in the mesh's own space; zero if it has none.
    virtual Vec3 Axis() const { return kVec3Zero; }

    float m_fLength = 0.0f; ///< of the last successful Build
    /// End of the bone in its node's space, as stored in a file; zero if not stored. The mesh can point
    /// elsewhere: see TKBVHStream.
    Vec3 m_kEnd = kVec3Zero;
};

/// A ball of radius 0.125 x length, for a branching bone.
class CBoneNodeMesh : public CBoneMesh
{
public:
    static const CRTTI ms_kRTTI;

    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    bool Build(float length) override;
    Vec3 Axis() const override { return m_kAxis; }

    Vec3 m_kAxis = kVec3UnitY;
};

/// A tapered bone from the origin to `length` along +Y.
class CBoneShapeMesh : public CBoneMesh
{
public:
    static const CRTTI ms_kRTTI;

    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    bool Build(float length) override;
    Vec3 Axis() const override { return m_kAxis; }

    Vec3 m_kAxis = kVec3UnitY;
};

/// A bone mesh class that has a record but is never created.
class CBoneObjMesh : public CBoneMesh
{
public:
    static const CRTTI ms_kRTTI;

    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
};

} // namespace gw
