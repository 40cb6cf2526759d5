#pragma once

#include <cstddef>
#include <functional>
#include <span>

namespace gw {

/// Where written bytes go. The answer is false when they could not be taken.
using CByteSink = std::function<bool(std::span<const std::byte>)>;

} // namespace gw
