#pragma once

#include "CBoneSkinControl.h"
#include "CConnectControl.h"
#include "CConnectData.h"
#include "CEditNormalControl.h"
#include "CEditNormalData.h"
#include "CMaterialBase.h"
#include "CMeshSelControl.h"
#include "CMorphControl.h"
#include "CNode.h"
#include "CParticleControl.h"
#include "CParticles.h"
#include "CShape.h"
#include "CSkinBoneControl.h"
#include "CTriMesh.h"
#include "CTriMeshUVWMap.h"
#include "CTriMeshUVWMapControl.h"

#include <algorithm>

namespace gw {

class CTestMaterial : public CMaterial
{
public:
    CTestMaterial() = default;
    CObject* CreateClone() const override { return new CTestMaterial(*this); }
};

/// Returns a unit cube of 8 points and 12 triangles; each face has its own four normals, 24 in total.
inline Ref<CTriMesh> Cube(int32_t colorCount = 0)
{
    Ref<CTriMesh> mesh = new CTriMesh;
    mesh->SetPointCount(8);
    mesh->SetNormalCount(24);
    mesh->SetColorCount(colorCount);
    mesh->SetTriangleQuantity(12);
    for (uint32_t i = 0; i < 8; ++i)
        mesh->XYZBuffer()[i] = {float(i & 1), float(i >> 1 & 1), float(i >> 2)};
    constexpr uint32_t kQuads[6][4] = {{0, 2, 3, 1}, {4, 5, 7, 6}, {0, 1, 5, 4},
                                       {2, 6, 7, 3}, {0, 4, 6, 2}, {1, 3, 7, 5}};
    constexpr uint32_t kCorners[6] = {0, 1, 2, 0, 2, 3};
    for (uint32_t corner = 0; corner < 36; ++corner)
    {
        mesh->XYZTriIndexBuffer()[corner] = kQuads[corner / 6][kCorners[corner % 6]];
        mesh->NormalTriIndexBuffer()[corner] = corner / 6 * 4 + kCorners[corner % 6];
    }
    return mesh;
}

/// Returns the cube with every block, two maps with a null between them, and no default values.
inline Ref<CTriMesh> FullMesh()
{
    Ref<CTriMesh> mesh = Cube(2);
    mesh->CreateXYZMtl();
    mesh->CreateTriangleMtlID();
    mesh->CreateSmoothFlag();
    mesh->ColorTriIndexBuffer()[5] = 1;
    mesh->XYZMtl()[3] = 4;
    mesh->SmoothFlag()[2] = 8;
    mesh->TriangleMtlID()[11] = 1;
    mesh->NormalBuffer()[7] = {0, 0, 1};
    mesh->ColorBuffer()[1] = {1, 0.5f, 0};
    mesh->m_kAttributeRanges = {AttributeRange{1, 0, 4}, AttributeRange{-2, 4, 8}};
    mesh->m_apkUVWMap.resize(3);
    for (const size_t slot : {0, 2})
    {
        CTriMeshUVWMap* map = new CTriMeshUVWMap;
        mesh->m_apkUVWMap[slot] = map;
        map->SetUVWCount(3);
        map->UVWBuffer()[2] = {0.5f, 0.25f, 0};
        map->SetTriangleQuantity(12);
        map->UVWTriIndexBuffer()[30] = 2;
    }
    mesh->m_bBoneMesh = true;
    mesh->BuildVertexTable();
    return mesh;
}

inline Mat4 Moved(float x, float y, float z)
{
    return Mat4Compose(kMat3Identity, {x, y, z});
}

/// Returns a geometry that only has points.
inline Ref<CTriMesh> PointMesh(const std::vector<Vec3>& points)
{
    Ref<CTriMesh> mesh = new CTriMesh;
    mesh->SetPointCount(static_cast<int32_t>(points.size()));
    std::ranges::copy(points, mesh->XYZBuffer().begin());
    return mesh;
}

/// Returns one triangle at (0, 0, 0), (1, 0, 0), (0, 1, 0), with a normal per corner.
inline Ref<CTriMesh> Triangle()
{
    Ref<CTriMesh> mesh = PointMesh({kVec3Zero, kVec3UnitX, kVec3UnitY});
    mesh->SetNormalCount(3);
    mesh->SetTriangleQuantity(1);
    for (uint32_t corner = 0; corner < 3; ++corner)
        mesh->XYZTriIndexBuffer()[corner] = mesh->NormalTriIndexBuffer()[corner] = corner;
    return mesh;
}

/// Returns a tree with an object of each class of the room. Bones come after the meshes
/// that they move, and data shared by two controls is shared.
Ref<CNode> ControlledScene();

} // namespace gw
