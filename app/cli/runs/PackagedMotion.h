#pragma once

#include <string>

namespace gw {

class CMotionFile;
class COrrinStream;

/// Reads a container. Returns false, after printing the reason, unless it is complete.
bool LoadWhole(COrrinStream& scene, const std::string& path);
/// Reads the motion inside a Kinetra file. Returns false, after printing the reason, if that fails.
bool LoadPackagedMotion(const std::string& path, CMotionFile& motion);
/// Same for a container that is already loaded.
bool LoadPackagedMotion(const std::string& path, const COrrinStream& scene, CMotionFile& motion);

} // namespace gw
