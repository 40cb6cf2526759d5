#pragma once

#include "ConvertedMotion.h"

#include <optional>

namespace gw {

class CFileConversion;
class CShellConversion;
struct ConversionChoices;
struct ConversionJob;
struct ShellOptions;

/// Returns the source and result of a finished conversion as clips, named after the job. Their trees belong
/// to the conversion. The result must already be saved: its tracks are changed to what its file contains.
ConvertedMotion MotionOf(const CFileConversion& conversion, const ConversionJob& job);

/// Returns the link from a page to a .glb file with a result: the result itself if it lies in the folder of
/// the page or below, or a file of its stem next to the page. Empty if there is none.
std::string ModelLink(const std::string& page, const std::string& result);

/// Compares source and result with the profile that the conversion used. Returns no value if the profile can
/// no longer be read or the motion has no frames.
std::optional<MeasuredConversion> MeasureMotion(const ConvertedMotion& motion,
                                                const std::string& profilePath);

/// Returns the choices that the options make.
ConversionChoices ChoicesOf(const ShellOptions& options);

/// Converts the job's source again, with other choices and without messages, and measures the result; nothing
/// is saved. Returns no value if that fails.
std::optional<MeasuredConversion> MeasureAnew(const ShellOptions& options, const ConversionChoices& choices,
                                              const ConversionJob& job, const CShellConversion& done);

} // namespace gw
