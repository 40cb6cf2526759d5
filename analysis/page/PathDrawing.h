#pragma once

#include "Vec3.h"

#include <cstddef>
#include <vector>

namespace gw {

class CMarkup;

/// Appends the paths of both roots seen from above: x to the right, z toward the viewer, with the same scale
/// and at most about `mostPoints` points per path. Appends nothing if a side has no path.
void AppendPaths(CMarkup& page, const std::vector<Vec3>& source, const std::vector<Vec3>& result,
                 size_t mostPoints);

} // namespace gw
