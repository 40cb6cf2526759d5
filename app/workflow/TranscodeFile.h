#pragma once

#include <string>

namespace gw {

class CFailureRecord;
class CMotionFile;

/// Returns why a motion cannot be written as .bvh, or null if it can.
const char* WhyNoBVH(const CMotionFile& motion);
/// Writes a motion as it is, without its last frame as .bvh, in meters as .glb, or otherwise as .htr with
/// `frameScale` times as many frames. Replaces an existing file. If that fails, records the reason and
/// returns false.
bool WriteTranscoded(CMotionFile& motion, const std::string& path, float frameScale, CFailureRecord& record);

} // namespace gw
