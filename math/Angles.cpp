#include "Angles.h"

#include <cmath>

namespace gw {

// In one translation unit, so that they are initialized in order: pi first, then the constants derived from
// it.
const double kPi64 = 4.0 * std::atan2(1.0, 1.0);
const double kTwoPi64 = kPi64 * 2.0;
const double kHalfPi64 = kPi64 * 0.5;
const double kInversePi64 = 1.0 / kPi64;
const double kInverseTwoPi64 = 1.0 / kTwoPi64;
const double kDegreesToRadians64 = kPi64 * 0.005555555555555556;
const double kRadiansToDegrees64 = 180.0 / kPi64;

const float kPi = static_cast<float>(kPi64);
const float kTwoPi = kPi * 2.0f;
const float kHalfPi = kPi * 0.5f;
const float kInversePi = 1.0f / kPi;
const float kInverseTwoPi = 1.0f / kTwoPi;
// Rounded once. A product with an already rounded pi would be one unit in the last place too large, and
// angles in files would drift with every load and save.
const float kDegreesToRadians = static_cast<float>(kDegreesToRadians64);
const float kRadiansToDegrees = 180.0f / kPi;

double SafeAcos(float x)
{
    if (x <= -1.0f)
        return kPi64;
    if (x >= 1.0f)
        return 0.0;
    return std::acos(static_cast<double>(x));
}

double SafeAsin(float x)
{
    if (x <= -1.0f)
        return kHalfPi64;
    if (x >= 1.0f)
        return -kHalfPi64;
    return std::asin(static_cast<double>(x));
}

} // namespace gw
