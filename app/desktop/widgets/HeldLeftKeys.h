#pragma once

#include "CContentWindow.h"

#include <set>

namespace gw {

/// Returns the left modifier keys that are down, even while another program has the keyboard. Empty on
/// systems that do not provide this. The application must exist.
std::set<EKey> HeldLeftKeys();

} // namespace gw
