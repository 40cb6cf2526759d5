#include "AttachBoneMeshes.h"

#include "Angles.h"
#include "BoneMeshQueries.h"
#include "CBoneMesh.h"
#include "CNode.h"

namespace gw {

namespace {

// initially a share of the bone's own offset; a child then determines the real length
constexpr float kFirstLength = 0.3f;

float OffsetLength(const CNode& node)
{
    return static_cast<float>(Vec3Length(node.m_kMatrix.Translation()));
}

// Counts the slots that hold a child; attaching children leaves spare ones.
size_t HeldChildCount(const CNode& node)
{
    size_t count = 0;
    for (size_t slot = 0; slot < node.GetChildCount(); ++slot)
        count += node.ChildAt(slot) ? 1 : 0;
    return count;
}

void AttachBoneMesh(CNode& node)
{
    Ref<CBoneMesh> mesh;
    if (HeldChildCount(node) > 1)
        mesh = new CBoneNodeMesh;
    else
        mesh = new CBoneShapeMesh;
    mesh->Build(kFirstLength * OffsetLength(node)); // a node without offset keeps an empty mesh
    node.AttachChild(mesh.Get());
}

// Rotates +Y to the dominant axis of an offset, whatever its sign. If that is Y, or no axis dominates, the
// rotation of the previous node is kept.
void TurnToOffset(const Vec3& offset, Mat3& rotation)
{
    const float x = offset.x * offset.x;
    const float y = offset.y * offset.y;
    const float z = offset.z * offset.z;
    if (x > y && x > z)
        rotation = Mat3FromAxisAngle(kVec3UnitZ, -kHalfPi);
    else if (z > x && z > y)
        rotation = Mat3FromAxisAngle(kVec3UnitX, kHalfPi);
}

} // namespace

bool AttachBoneMeshes(CObject* root)
{
    std::vector<CObject*> nodes;
    if (root)
        root->FindObjects(nodes, nullptr, &CNode::ms_kRTTI, false);
    for (CObject* node : nodes)
        AttachBoneMesh(static_cast<CNode&>(*node));

    Mat3 rotation = kMat3Identity;
    for (CObject* object : nodes)
    {
        const CNode& node = static_cast<const CNode&>(*object);
        if (!node.GetParent())
            continue;
        TurnToOffset(node.m_kMatrix.Translation(), rotation);
        CNode* parent = node.GetParentNode();
        CBoneMesh* mesh = parent ? FindBoneMesh(*parent) : nullptr;
        if (!mesh)
            continue;
        mesh->Build(OffsetLength(node));
        mesh->m_kMatrix = Mat4Compose(rotation, kVec3Zero);
    }
    return true;
}

} // namespace gw
