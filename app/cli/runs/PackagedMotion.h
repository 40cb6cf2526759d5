#pragma once

#include "Notice.h"

#include <optional>
#include <string>

namespace gw {

class CMotionFile;
class COrrinStream;
struct ShellOptions;

/// Reads a container. Returns false, after printing the reason about `shownPath`, unless it is complete.
bool LoadWhole(COrrinStream& scene, const std::string& path, const std::string& shownPath);
/// Reads the motion inside a Kinetra file that is loaded. Returns the reason if that fails.
std::optional<Notice> WhyNotUnpacked(const std::string& path, const COrrinStream& scene, CMotionFile& motion);
/// Same, but prints the reason. Returns false if that fails.
bool LoadPackagedMotion(const std::string& path, const COrrinStream& scene, CMotionFile& motion);

/// Reads a motion of any format: a file, a stream, or the motion inside a Kinetra file. Prints warnings.
/// Returns false, after printing the reason, if that fails. `rate`, in frames per second, replaces the
/// file's, unless it is 0.
bool LoadMotion(const ShellOptions& options, const std::string& path, float rate, CMotionFile& motion);

/// Returns how many frames a result has for each frame of its source, 1 to 4; 1 for any other motion. A
/// conversion writes the last source frame that often, so the repeated poses at the end are counted. A result
/// that ends in a still pose counts as 4, which is what the installed bone maps give.
int FramesPerSourceFrame(const CMotionFile& motion);
/// Warns about the rate in the header of a result with several frames per source frame: it is the source's.
void SayRateOfResult(const ShellOptions& options, const std::string& path, const CMotionFile& motion);

} // namespace gw
