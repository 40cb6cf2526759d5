#pragma once

#include "CSourceFile.h"

#include <string>

namespace gw {

/// Opens a source like CSourceFile::Open, but prints the reason of a failure.
bool OpenSource(CSourceFile& source, const std::string& path, EPackage package);

} // namespace gw
