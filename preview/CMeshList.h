#pragma once

#include "CTriMesh.h"
#include "Ref.h"

#include <span>
#include <vector>

namespace gw {

/// The triangle meshes of a scene in the order in which a search finds them, kept from frame to frame. They
/// stay alive while they are listed.
class CMeshList
{
public:
    /// All meshes under a root. The search is made again only when the tree's spatials are others, or stand
    /// elsewhere, than at the last call; valid until the next one.
    std::span<const Ref<CTriMesh>> Of(CSpatial& root);
    void Clear();

private:
    std::vector<Ref<CSpatial>>
        m_kTree; // depth first; counted, so that no new spatial can pass for an old one
    std::vector<Ref<CTriMesh>> m_kMeshes;
};

} // namespace gw
