#pragma once

#include <mutex>

namespace gw {

/// A lock within this process; see std::lock_guard.
using CSection = std::mutex;

} // namespace gw
