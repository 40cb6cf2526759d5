#pragma once

#include "CByteSink.h"
#include "Vec3.h"

#include <string>

namespace gw {

class CFailureRecord;
class CMotionFile;

/// Sends a motion to a sink as binary glTF 2: its nodes as the joints of a skin, with the rest pose in the
/// nodes and in the inverse bind matrices, a body of boxes along the bones, and one animation with a key per
/// frame. glTF is in meters, with Y up: `metersPerUnit` is the length of a unit of the motion, and `up` the
/// axis that is up in it; another one than Y is turned by a node above the joints. Leaves the tree's controls
/// switched on. Returns false, with the reason in the record, without a motion or if the sink
/// refuses the bytes.
bool WriteGlb(const CMotionFile& motion, double metersPerUnit, const CByteSink& sink, CFailureRecord& record,
              const Vec3& up = kVec3UnitY);
/// Replaces a file atomically with that.
bool SaveGlb(const CMotionFile& motion, double metersPerUnit, const std::string& path, CFailureRecord& record,
             const Vec3& up = kVec3UnitY);

} // namespace gw
