#pragma once

#include <string>

namespace gw {

class CMotionFile;
class COrrinStream;

/// Reads a container, which must be complete. Prints what is wrong with it.
bool LoadWhole(COrrinStream& scene, const std::string& path);
/// Reads the motion inside a Kinetra file. Prints why it fails.
bool LoadPackagedMotion(const std::string& path, CMotionFile& motion);
/// Same for a container that is already loaded.
bool LoadPackagedMotion(const std::string& path, const COrrinStream& scene, CMotionFile& motion);

} // namespace gw
