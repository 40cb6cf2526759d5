#pragma once

#include "CSceneNodes.h"
#include "SceneSkeleton.h"

namespace gw {

struct ImportedMotion;

/// A clip, and how it is sampled.
struct SceneClip
{
    const aiAnimation* animation = nullptr; ///< null for a pose without motion
    double rate = 30.0;                     ///< frames per second
    bool isRateOfFile = false;
    double frames = 1.0; ///< number of frames, a whole number
};

/// Plans the sampling of a clip. `rate` is used if the file has none; 0 for 30.
SceneClip PlanClip(const CSceneNodes& nodes, const aiAnimation* animation, double rate);

/// Samples the clip, and adds the skeleton's joints with their keys to the motion. `upright` is applied to
/// the world.
void SampleJoints(const CSceneNodes& nodes, const SceneSkeleton& skeleton, const SceneClip& clip,
                  const SceneMatrix& upright, ImportedMotion& motion);

} // namespace gw
