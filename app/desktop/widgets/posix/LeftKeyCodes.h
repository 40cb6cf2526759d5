#pragma once

#include <cstdint>

namespace gw {

/// The native key symbols of the left keys, those of X.
inline constexpr uint32_t kLeftCtrl = 0xffe3;
inline constexpr uint32_t kLeftShift = 0xffe1;

} // namespace gw
