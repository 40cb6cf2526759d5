#pragma once

#include <cstddef>
#include <vector>

namespace gw {

class CKeyframeControl;
class CNode;

/// Poses an animated tree frame by frame, as far as local matrices are concerned. If every node depends only
/// on its own track, as in trees from the readers and the retargeter, only the tracks are sampled, and nodes
/// can be posed one by one. Any other tree is evaluated as a whole. Do not change the tree while the sampler
/// is in use.
class CMotionSampler
{
public:
    explicit CMotionSampler(CNode& root);

    /// Returns all nodes, depth first.
    const std::vector<CNode*>& Nodes() const { return m_kNodes; }
    /// Sets the local matrices of all nodes for a time.
    void PoseTree(float time);
    /// Returns whether PoseNode can be called.
    bool PosesNodes() const { return m_bPosesNodes; }
    /// Returns the track that alone poses a node, or null if the node does not move.
    const CKeyframeControl* TrackOf(size_t index) const { return m_kTracks[index]; }
    /// Sets the local matrix of one node for a time.
    void PoseNode(size_t index, float time);

private:
    bool FindTracks();

    CNode& root_;
    std::vector<CNode*> m_kNodes;
    std::vector<CKeyframeControl*> m_kTracks; // one per node; null if it does not move
    bool m_bPosesNodes;
};

/// Returns the time of frame i / frameScale in a motion with this frequency (seconds per frame).
float TimeOfFrame(int i, float frequency, float frameScale = 1.0f);

} // namespace gw
