#pragma once

#include "CFailure.h"
#include "Ref.h"

#include <string>

namespace gw {

class CRawData;

/// Returns a new object with a file's bytes, without name, creator or chain; null if the file cannot be read.
/// The bytes of a large file stay in the file, which must not change while the object is in use.
Ref<CRawData> LoadFileAsRawData(const std::string& path);

/// Wraps a motion file into a Kinetra package. The third and fourth argument go into the info block. False
/// when the source cannot be read; true otherwise, even when the target could not be written: `record` tells
/// the truth.
bool PackageMotion(const std::string& sourcePath, const std::string& targetPath, float third, float fourth,
                   CFailureRecord& record);

} // namespace gw
