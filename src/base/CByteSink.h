#pragma once

#include <cstddef>
#include <functional>
#include <span>

namespace gw {

/// Receives written bytes. Returns false if they could not be stored.
using CByteSink = std::function<bool(std::span<const std::byte>)>;

} // namespace gw
