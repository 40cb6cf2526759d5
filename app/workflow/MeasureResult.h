#pragma once

#include "MeasureConversion.h"
#include "MeasuredConversion.h"

#include <optional>
#include <span>

namespace gw {

class CFileConversion;

/// Returns the source of a finished conversion as it was read; it moves by the track that was used to convert
/// it.
MotionClip SourceClipOf(const CFileConversion& conversion);

/// Compares a source with its result, whose tracks are as in its file (TakeWrittenPoses). Returns no value if
/// one of them has no frames.
std::optional<MeasuredConversion> MeasureResult(const MotionClip& source, const MotionClip& result,
                                                std::span<const BonePair> pairs);

} // namespace gw
