#include "Mat3.h"

#include <cmath>

namespace gw {

Mat3& Mat3Multiply(const Mat3& a, const Mat3& b, Mat3& out)
{
    out = a * b;
    return out;
}

Mat3 Mat3FromAxisAngle(const Vec3& axis, float angle)
{
    const double c = std::cos(static_cast<double>(angle));
    const double s = std::sin(static_cast<double>(angle));
    const double t = 1.0 - c;
    const double x = axis.x;
    const double y = axis.y;
    const double z = axis.z;
    return {
        {static_cast<float>(x * x * t + c), static_cast<float>(x * y * t + z * s),
         static_cast<float>(x * z * t - y * s), static_cast<float>(x * y * t - z * s),
         static_cast<float>(y * y * t + c), static_cast<float>(y * z * t + x * s),
         static_cast<float>(x * z * t + y * s), static_cast<float>(y * z * t - x * s),
         static_cast<float>(z * z * t + c)}
    };
}

void Mat3FromAxisAngle(Mat3& out, const Vec3& axis, float angle)
{
    out = Mat3FromAxisAngle(axis, angle);
}

Mat3 Mat3InverseOrIdentity(const Mat3& a)
{
    const float* m = a.m;
    const auto minor = [m](int i, int j, int k, int l) {
        return static_cast<double>(m[i]) * m[j] - static_cast<double>(m[k]) * m[l];
    };
    const double cofactor[9] = {minor(4, 8, 5, 7), minor(2, 7, 1, 8), minor(1, 5, 2, 4),
                                minor(5, 6, 3, 8), minor(0, 8, 2, 6), minor(2, 3, 0, 5),
                                minor(3, 7, 4, 6), minor(1, 6, 0, 7), minor(0, 4, 1, 3)};
    const double reciprocal = 1.0 / (m[0] * cofactor[0] + m[1] * cofactor[3] + m[2] * cofactor[6]);
    if (!std::isfinite(static_cast<float>(reciprocal)))
        return kMat3Identity;
    Mat3 out;
    for (int i = 0; i < 9; ++i)
        out.m[i] = static_cast<float>(cofactor[i] * reciprocal);
    return out;
}

} // namespace gw
