#pragma once

#include "CTriMesh.h"
#include "Ref.h"

#include <span>
#include <vector>

namespace gw {

/// The triangle meshes of a scene in search order, cached between frames. They are kept alive while they are
/// listed.
class CMeshList
{
public:
    /// Returns all meshes under a root. Searches again only if the tree's spatials or their order have
    /// changed since the last call; valid until the next one.
    std::span<const Ref<CTriMesh>> Of(CSpatial& root);
    void Clear();

private:
    std::vector<Ref<CSpatial>>
        m_kTree; // depth first; counted, so that a new spatial cannot reuse an old address
    std::vector<Ref<CTriMesh>> m_kMeshes;
};

} // namespace gw
