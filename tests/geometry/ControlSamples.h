#pragma once

#include "CBoneSkinControl.h"
#include "CConnectControl.h"
#include "CConnectData.h"
#include "CEditNormalControl.h"
#include "CEditNormalData.h"
#include "CMeshSelControl.h"
#include "CMorphControl.h"
#include "CNode.h"
#include "CParticleControl.h"
#include "CParticles.h"
#include "CShape.h"
#include "CSkinBoneControl.h"
#include "CTriMeshUVWMapControl.h"
#include "MeshSamples.h"

namespace gw {

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

/// Returns a tree with an object of each class of the room and no default values. Bones come after the meshes
/// that they move, and data shared by two controls is shared.
Ref<CNode> ControlledScene();

} // namespace gw
