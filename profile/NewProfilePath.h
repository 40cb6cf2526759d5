#pragma once

#include <string>

namespace gw {

class CProfileOwner;

/// A path for a new profile of the user's that no file or folder has yet; the last one of all where every
/// number is taken.
std::string NewProfilePath(CProfileOwner& owner);

} // namespace gw
