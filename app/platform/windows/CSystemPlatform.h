#pragma once

#include "CRegistryPlatform.h"

namespace gw {

/// The platform of the system that the program runs on.
using CSystemPlatform = CRegistryPlatform;

} // namespace gw
