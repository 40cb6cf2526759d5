#pragma once

#include "Vec3.h"

#include <cstddef>
#include <vector>

namespace gw {

class CMarkup;

/// Appends the ways of both roots over the ground, seen from above: x to the right, z towards the viewer, in
/// one scale. About `mostPoints` points a way. Nothing where a side has no way.
void AppendPaths(CMarkup& page, const std::vector<Vec3>& source, const std::vector<Vec3>& result,
                 size_t mostPoints);

} // namespace gw
