#include "CMeshList.h"

#include "CNode.h"

namespace gw {

namespace {

// Calls a function for each spatial of a tree, depth first, until it returns false.
template <class F>
bool WalkTree(CSpatial& spatial, F& visit)
{
    if (!visit(spatial))
        return false;
    const CNode* const node = RecordCast<CNode>(&spatial);
    const size_t slots = node ? node->GetChildCount() : 0;
    for (size_t slot = 0; slot < slots; ++slot)
    {
        CSpatial* const child = node->ChildAt(slot);
        if (child && !WalkTree(*child, visit))
            return false;
    }
    return true;
}

bool IsTree(CSpatial& root, std::span<const Ref<CSpatial>> tree)
{
    size_t next = 0;
    const auto follows = [&](CSpatial& spatial) { return next < tree.size() && tree[next++] == &spatial; };
    return WalkTree(root, follows) && next == tree.size();
}

} // namespace

std::span<const Ref<CTriMesh>> CMeshList::Of(CSpatial& root)
{
    if (IsTree(root, m_kTree))
        return m_kMeshes;
    Clear();
    const auto append = [&](CSpatial& spatial) { return m_kTree.emplace_back(&spatial), true; };
    WalkTree(root, append);
    std::vector<CObject*> found;
    root.FindObjects(found, nullptr, &CTriMesh::ms_kRTTI, true);
    for (CObject* mesh : found)
        m_kMeshes.emplace_back(static_cast<CTriMesh*>(mesh));
    return m_kMeshes;
}

void CMeshList::Clear()
{
    m_kTree.clear();
    m_kMeshes.clear();
}

} // namespace gw
