#pragma once

#include "CTriMesh.h"

namespace gw {

/// A small solid of fixed shape that shows a bone, scaled to the bone's length and hung under the bone's
/// node. In a file it is a triangle mesh under its own class name, which no reader takes back; its clone is a
/// plain CTriMesh.
class CBoneMesh : public CTriMesh
{
public:
    static const CRTTI ms_kRTTI;

    CBoneMesh() { m_bBoneMesh = true; }
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }

    /// Makes the shape at a length. False, and nothing changes, at or below 0.
    virtual bool Build(float length) = 0;
    /// The direction of the bone in the mesh's own space; zero for a mesh that has none.
    virtual Vec3 Axis() const { return kVec3Zero; }

    float m_fLength = 0.0f; ///< given to the last Build that succeeded
    /// Where the bone ends in its node's space, as a file told it; zero where none did. The mesh's direction
    /// is not always that: see TKBVHStream.
    Vec3 m_kEnd = kVec3Zero;
};

/// A ball of radius 0.125 x length, for a bone that branches.
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

/// A class of bone mesh that has a record and that nothing makes.
class CBoneObjMesh : public CBoneMesh
{
public:
    static const CRTTI ms_kRTTI;

    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
};

} // namespace gw
