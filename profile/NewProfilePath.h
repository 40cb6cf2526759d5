#pragma once

#include <string>

namespace gw {

class CProfileOwner;

/// Returns an unused path for a new custom profile, or the last candidate if all numbers are used.
std::string NewProfilePath(CProfileOwner& owner);

} // namespace gw
