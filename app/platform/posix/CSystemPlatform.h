#pragma once

#include "CFilePlatform.h"

namespace gw {

/// The platform of the system that the program runs on.
using CSystemPlatform = CFilePlatform;

} // namespace gw
