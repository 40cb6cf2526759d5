#pragma once

#include "ConvertedMotion.h"

#include <optional>

namespace gw {

class CFileConversion;
struct ConversionJob;
struct ShellOptions;

/// The source of a conversion that is made, as it was read; it moves by the track by which it was converted.
MotionClip SourceClipOf(const CFileConversion& conversion);

/// The source and the result of a conversion that is made, as clips of trees that live with it; named after
/// the job. The result is saved already: its tracks become what its file has of them.
ConvertedMotion MotionOf(const CFileConversion& conversion, const ConversionJob& job);

/// Compares source and result by the profile that the conversion used. Returns nothing if the profile can no
/// longer be read or the motion has no frames.
std::optional<MeasuredConversion> MeasureMotion(const ConvertedMotion& motion,
                                                const std::string& profilePath);

/// Converts the job's source once more by the plain rules, without a word, and measures what comes of it.
/// Nothing where that fails, and where the options ask for the plain rules as it is.
std::optional<MeasuredConversion> MeasurePlainRules(const ShellOptions& options, const ConversionJob& job,
                                                    const std::string& profilePath);

} // namespace gw
