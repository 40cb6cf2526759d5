#pragma once

#include "ConvertedMotion.h"

#include <optional>

namespace gw {

class CFileConversion;
struct ConversionJob;
struct ShellOptions;

/// Returns the source of a finished conversion as it was read; it moves by the track that was used to convert
/// it.
MotionClip SourceClipOf(const CFileConversion& conversion);

/// Returns the source and result of a finished conversion as clips, named after the job. Their trees belong
/// to the conversion. The result must already be saved: its tracks are changed to what its file contains.
ConvertedMotion MotionOf(const CFileConversion& conversion, const ConversionJob& job);

/// Compares source and result with the profile that the conversion used. Returns no value if the profile can
/// no longer be read or the motion has no frames.
std::optional<MeasuredConversion> MeasureMotion(const ConvertedMotion& motion,
                                                const std::string& profilePath);

/// Converts the job's source again with the default conversion, without messages, and measures the result.
/// Returns no value if that fails, or if the options already select the default conversion.
std::optional<MeasuredConversion> MeasurePlainRules(const ShellOptions& options, const ConversionJob& job,
                                                    const std::string& profilePath);

} // namespace gw
