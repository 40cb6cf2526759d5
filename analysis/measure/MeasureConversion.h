#pragma once

#include "BonePairs.h"
#include "ConversionDetail.h"
#include "ConversionMeasures.h"

#include <span>

namespace gw {

class CMotionFile;
class CNode;

/// A tree of nodes with tracks, as a stream leaves it: frame f is reached at the time f / frequency.
struct MotionClip
{
    CNode* root = nullptr;
    float frequency = 0.0f; ///< seconds from frame to frame
    int frameCount = 0;
};

/// The motion of a loaded file, which must outlive the clip.
MotionClip ClipOf(const CMotionFile& file);

/// Measures a conversion at every frame of the source; frame f there is frame f x FrameScaleOf(...) of the
/// result. Both trees are posed and stay as the last frame left them. A clip without a root or frames gives a
/// record without figures. `detail`, where there is one, is made anew and takes what happens frame by frame.
ConversionMeasures MeasureConversion(const MotionClip& source, const MotionClip& result,
                                     std::span<const BonePair> pairs, ConversionDetail* detail = nullptr);

} // namespace gw
