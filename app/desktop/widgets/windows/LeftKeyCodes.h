#pragma once

#include <cstdint>

namespace gw {

/// The native codes of the left keys.
inline constexpr uint32_t kLeftCtrl = 0xa2;
inline constexpr uint32_t kLeftShift = 0xa0;

} // namespace gw
