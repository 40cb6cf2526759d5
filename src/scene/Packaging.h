#pragma once

#include "CFailure.h"
#include "Ref.h"

#include <string>

namespace gw {

class CRawData;

/// A new object with a file's bytes, without name, creator or chain; null when the file cannot be read.
Ref<CRawData> LoadFileAsRawData(const std::string& path);

/// Wraps a motion file into a Kinetra package. The third and fourth argument go into the info block. False
/// when the source cannot be read; true otherwise, even when the target could not be written: `record` tells
/// the truth.
bool PackageMotion(const std::string& sourcePath, const std::string& targetPath, float third, float fourth,
                   CFailureRecord& record);

} // namespace gw
