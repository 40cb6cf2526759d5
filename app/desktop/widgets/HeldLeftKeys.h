#pragma once

#include "CContentWindow.h"

#include <set>

namespace gw {

/// The left modifier keys that are down on the keyboard, also while another program has it. Empty on systems
/// that do not reveal this; the application must exist.
std::set<EKey> HeldLeftKeys();

} // namespace gw
