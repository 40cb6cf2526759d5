#pragma once

#include <string_view>

namespace gw {

/// The bone of the host skeleton whose mapping every conversion needs.
inline constexpr std::string_view kRootBone = "LowerTorso";

/// The bones of the host skeleton that no source drives: every profile has a fixed row for each.
inline constexpr std::string_view kPelvisBones[] = {"LPelvis", "RPelvis"};

} // namespace gw
