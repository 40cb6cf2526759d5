#pragma once

#include <cstddef>
#include <vector>

namespace gw {

class CKeyframeControl;
class CNode;

/// Poses an animated tree frame by frame for those who look at local matrices. Planned once: where every node
/// hangs on its own track alone, which is how the streams and the retargeter leave their trees, only the
/// tracks are asked, and nodes may be posed one by one. Any other tree is evaluated as a whole. The tree must
/// stay as it is meanwhile.
class CMotionSampler
{
public:
    explicit CMotionSampler(CNode& root);

    /// All nodes, depth first.
    const std::vector<CNode*>& Nodes() const { return m_kNodes; }
    /// Brings the local matrices of all nodes to a time.
    void PoseTree(float time);
    /// Whether PoseNode may be called.
    bool PosesNodes() const { return m_bPosesNodes; }
    /// The track that alone poses a node, or null if the node does not move.
    const CKeyframeControl* TrackOf(size_t index) const { return m_kTracks[index]; }
    /// Brings the local matrix of one node to a time.
    void PoseNode(size_t index, float time);

private:
    bool FindTracks();

    CNode& root_;
    std::vector<CNode*> m_kNodes;
    std::vector<CKeyframeControl*> m_kTracks; // for each node, or null where it does not move
    bool m_bPosesNodes;
};

/// The time at which a motion of a frequency stands at frame i / frameScale.
float TimeOfFrame(int i, float frequency, float frameScale = 1.0f);

} // namespace gw
