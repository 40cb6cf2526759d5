#pragma once

#include <string>

namespace gw {

class CMotionFile;
class COrrinStream;

/// Reads a container that must be whole. Says what is wrong with any other.
bool LoadWhole(COrrinStream& scene, const std::string& path);
/// Reads the motion inside a Kinetra file. Says why it cannot.
bool LoadPackagedMotion(const std::string& path, CMotionFile& motion);
/// The same out of a container that is read already.
bool LoadPackagedMotion(const std::string& path, const COrrinStream& scene, CMotionFile& motion);

} // namespace gw
