#pragma once

#include "CSceneNodes.h"

#include <vector>

namespace gw {

/// The channels of one clip, assigned to the nodes that they move.
class CNodeTracks
{
public:
    /// The animation may be null: then nothing moves.
    CNodeTracks(const CSceneNodes& nodes, const aiAnimation* animation);

    /// Returns the local matrices of all nodes at a time in ticks. Before the first key and after the last
    /// one, a channel keeps that key.
    std::vector<SceneMatrix> LocalsAt(double ticks) const;

private:
    const CSceneNodes& nodes_;
    std::vector<SceneMatrix> m_kDefaults;
    std::vector<const aiNodeAnim*> m_kChannels; // of each node; null if the clip leaves it alone
};

} // namespace gw
