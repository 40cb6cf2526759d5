#pragma once

#include "CFailureRecord.h"
#include "Ref.h"

#include <string>

namespace gw {

class CRawData;

/// Returns a new object with a file's bytes, without name, creator or chain; null if the file cannot be read.
/// The bytes of a large file are not copied, so it must not change while the object is in use.
Ref<CRawData> LoadFileAsRawData(const std::string& path);

/// Wraps a motion file into a Kinetra package. The third and fourth arguments go into the info block. Returns
/// false only if the source cannot be read; `record` also reports a target that could not be written.
bool PackageMotion(const std::string& sourcePath, const std::string& targetPath, float third, float fourth,
                   CFailureRecord& record);

} // namespace gw
