#include "BoneMeshQueries.h"

#include "CBoneMesh.h"
#include "CNode.h"

namespace gw {

CBoneMesh* FindBoneMesh(const CNode& node)
{
    for (size_t slot = 0; slot < node.GetChildCount(); ++slot)
    {
        if (CBoneMesh* mesh = RecordCast<CBoneMesh>(node.ChildAt(slot)))
            return mesh;
    }
    return nullptr;
}

float NodeBoneLength(const CNode& node)
{
    const CBoneMesh* mesh = FindBoneMesh(node);
    return mesh ? mesh->m_fLength : 0.0f;
}

Vec3 NodeBoneAxis(const CNode& node)
{
    const CBoneMesh* mesh = FindBoneMesh(node);
    return mesh ? mesh->Axis() : kVec3Zero;
}

const Mat4& NodeBoneWorld(const CNode& node)
{
    const CBoneMesh* mesh = FindBoneMesh(node);
    return mesh ? mesh->m_kWorldMatrix : node.m_kWorldMatrix;
}

Vec3 NodeBoneEnd(const CNode& node)
{
    const CBoneMesh* mesh = FindBoneMesh(node);
    if (!mesh || mesh->m_kEnd != kVec3Zero)
        return mesh ? mesh->m_kEnd : kVec3Zero;
    return TransformCoord(mesh->Axis() * mesh->m_fLength, mesh->m_kMatrix);
}

} // namespace gw
