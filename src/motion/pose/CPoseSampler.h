#pragma once

#include "CNode.h"

#include <unordered_set>
#include <vector>

namespace gw {

class CKeyframeControl;

/// Returns whether a track's frequency is a usable frame time in seconds; odd files contain infinity and 0.
bool IsFrameTime(float frequency);
/// Returns the time of a frame, which can lie between two keys. `frequency` is the tracks' frame time in
/// seconds; an unusable one counts as 1.
float TimeOfPose(double frame, float frequency);

/// Poses only the watched nodes of a motion's tree and their ancestors: no meshes, no bounds.
class CPoseSampler
{
public:
    /// `frequency` is that of TimeOfPose.
    explicit CPoseSampler(float frequency) : m_fFrequency(frequency) {}

    /// Keeps a node's world matrix up to date from the next Pose on. Null is ignored.
    void Watch(CNode* node);
    /// Poses the watched nodes at a frame, which can lie between two keys.
    void Pose(double frame);

private:
    float m_fFrequency;
    std::vector<CNode*> m_kNodes; // parents before children
    std::unordered_set<const CNode*> m_kWatched;
};

/// Returns the first track of a node, or null.
const CKeyframeControl* TrackOf(const CNode& node);
/// Returns a node's rest matrix, relative to its parent.
const Mat4& RestLocal(const CNode& node);
/// Returns a node's world matrix in the tree's rest pose, without posing the tree.
Mat4 RestWorld(const CNode& node);

} // namespace gw
