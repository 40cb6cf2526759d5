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

/// Warns about the rate in the header of an .htr that a conversion wrote: it is the source's, although the
/// result has more frames.
void SayRateOfResult(const ShellOptions& options, const std::string& path, const CMotionFile& motion);

} // namespace gw
