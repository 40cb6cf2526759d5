#pragma once

#include "CByteSink.h"

#include <string>

namespace gw {

class CFailureRecord;
class CMotionFile;

/// Sends a motion to a sink as binary glTF 2: its nodes as the joints of a skin, with the rest pose in the
/// nodes and in the inverse bind matrices, a body of boxes along the bones, and one animation with a key per
/// frame. glTF is in meters: `metersPerUnit` is the length of a unit of the motion. Leaves the tree's
/// controls switched on. Returns false, with the reason in the record, without a motion or if the sink
/// refuses the bytes.
bool WriteGlb(const CMotionFile& motion, double metersPerUnit, const CByteSink& sink, CFailureRecord& record);
/// Replaces a file atomically with that.
bool SaveGlb(const CMotionFile& motion, double metersPerUnit, const std::string& path,
             CFailureRecord& record);

} // namespace gw
