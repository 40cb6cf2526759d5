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

    /// Sets the world matrices of all nodes for a time in ticks. Before the first key and after the last one,
    /// a channel keeps that key.
    void PoseAt(double ticks, std::vector<SceneMatrix>& worlds) const;

private:
    /// The keys of a node, and its place in the file for what has no keys.
    struct Channel
    {
        const aiNodeAnim* keys = nullptr; ///< null if the clip leaves the node alone
        aiVector3t<double> scale;
        aiQuaterniont<double> rotation;
        aiVector3t<double> position;
    };

    static SceneMatrix LocalAt(const Channel& channel, double ticks);

    const CSceneNodes& nodes_;
    std::vector<SceneMatrix> m_kDefaults;
    std::vector<Channel> m_kChannels; // of each node
};

} // namespace gw
