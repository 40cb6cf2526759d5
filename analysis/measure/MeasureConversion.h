#pragma once

#include "BonePairs.h"
#include "ConversionDetail.h"
#include "ConversionMeasures.h"

#include <span>

namespace gw {

class CMotionFile;
class CNode;

/// A tree of nodes with tracks, as created by a stream: frame f is reached at time f / frequency.
struct MotionClip
{
    CNode* root = nullptr;
    float frequency = 0.0f; ///< frame time in seconds
    int frameCount = 0;
};

/// Returns the motion of a loaded file, which must outlive the clip.
MotionClip ClipOf(const CMotionFile& file);

/// Measures a conversion at every frame of the source; its frame f corresponds to frame f x FrameScaleOf(...)
/// of the result. Both trees are posed, and are left in the pose of the last frame. If a clip has no root or
/// no frames, the record has no figures. `detail`, unless null, is overwritten with the frame-by-frame
/// values.
ConversionMeasures MeasureConversion(const MotionClip& source, const MotionClip& result,
                                     std::span<const BonePair> pairs, ConversionDetail* detail = nullptr);

} // namespace gw
