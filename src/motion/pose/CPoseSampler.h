#pragma once

#include "CNode.h"

#include <unordered_set>
#include <vector>

namespace gw {

class CKeyframeControl;

/// Whether a track's frequency is seconds from frame to frame: odd files give infinities and 0.
bool IsFrameTime(float frequency);

/// Poses of a motion's tree, of the nodes that somebody watches and those above them: no meshes, no bounds.
class CPoseSampler
{
public:
    /// `frequency` is the tracks' seconds from frame to frame; one that is no such number counts as 1.
    explicit CPoseSampler(float frequency);

    /// Keeps a node's world matrix right from the next Pose on. Null is nothing to watch.
    void Watch(CNode* node);
    /// Brings the watched nodes to a frame, which may lie between two keys.
    void Pose(double frame);

private:
    double m_fFrequency;
    std::vector<CNode*> m_kNodes; // parents before their children
    std::unordered_set<const CNode*> m_kWatched;
};

/// The first track of a node, or null.
const CKeyframeControl* TrackOf(const CNode& node);
/// The matrix that a node has in the rest pose, relative to its parent.
const Mat4& RestLocal(const CNode& node);
/// The world matrix of a node in the rest pose of its tree, which need not be posed so.
Mat4 RestWorld(const CNode& node);

} // namespace gw
