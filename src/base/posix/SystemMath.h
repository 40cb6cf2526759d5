#pragma once

#include <cmath>

namespace gw {

/// Returns the Bessel function of the first kind and order 1, which only some C libraries have.
inline double BesselJ1(double x)
{
    return ::j1(x);
}

} // namespace gw
