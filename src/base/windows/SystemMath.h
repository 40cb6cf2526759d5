#pragma once

#include <cmath>

namespace gw {

/// Returns the Bessel function of the first kind and order 1, which only some C libraries have.
inline double BesselJ1(double x)
{
    return x < 0.0 ? -std::cyl_bessel_j(1.0, -x) : std::cyl_bessel_j(1.0, x);
}

} // namespace gw
