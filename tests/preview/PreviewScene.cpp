#include "PreviewScene.h"

#include <numeric>

namespace gw {

Ref<CNode> MakeScene(const BoundSphere& bound)
{
    Ref<CNode> root = new CNode;
    root->m_kBound = bound;
    return root;
}

CTimeKeeper& AttachKeeper(CNode& root)
{
    auto* const keeper = new CTimeKeeper;
    root.AttachControl(keeper);
    return *keeper;
}

CTriMesh& AttachBone(CNode& parent, const char* name, int32_t triangles, const Vec3& place)
{
    auto* const bone = new CNode;
    bone->SetName(name);
    bone->m_kMatrix.SetTranslation(place);
    auto* const mesh = new CTriMesh;
    mesh->SetPointCount(3 * triangles);
    mesh->SetTriangleQuantity(triangles);
    float z = 0.0f;
    for (size_t i = 0; i < mesh->XYZBuffer().size(); i += 3, z += 1.0f)
    {
        mesh->XYZBuffer()[i] = {-10.0f, -10.0f, z};
        mesh->XYZBuffer()[i + 1] = {10.0f, -10.0f, z};
        mesh->XYZBuffer()[i + 2] = {0.0f, 10.0f, z};
    }
    std::iota(mesh->XYZTriIndexBuffer().begin(), mesh->XYZTriIndexBuffer().end(), 0);
    bone->AttachChild(mesh);
    parent.AttachChild(bone);
    return *mesh;
}

} // namespace gw
