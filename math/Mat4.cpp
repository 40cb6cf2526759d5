#include "Mat4.h"

#include <cmath>

namespace gw {

void Mat4Compose(Mat4& out, const Mat3* rotation, const Vec3* translation, const Vec3* scale)
{
    out = Mat4Compose(rotation ? *rotation : kMat3Identity, translation ? *translation : kVec3Zero,
                      scale ? *scale : kVec3One);
}

Mat4* Mat4Multiply(Mat4* out, const Mat4* a, const Mat4* b)
{
    if (!out || !a || !b)
        return nullptr;
    *out = *a * *b;
    return out;
}

Mat4* Mat4Inverse(Mat4* out, float* determinant, const Mat4* m)
{
    if (!out || !m)
        return nullptr;
    double e[16];
    for (int i = 0; i < 16; ++i)
        e[i] = static_cast<double>(m->m[i]);

    // 2x2 minors of the upper two and the lower two rows, for a Laplace expansion along them.
    const double s0 = e[0] * e[5] - e[4] * e[1];
    const double s1 = e[0] * e[6] - e[4] * e[2];
    const double s2 = e[0] * e[7] - e[4] * e[3];
    const double s3 = e[1] * e[6] - e[5] * e[2];
    const double s4 = e[1] * e[7] - e[5] * e[3];
    const double s5 = e[2] * e[7] - e[6] * e[3];
    const double c5 = e[10] * e[15] - e[14] * e[11];
    const double c4 = e[9] * e[15] - e[13] * e[11];
    const double c3 = e[9] * e[14] - e[13] * e[10];
    const double c2 = e[8] * e[15] - e[12] * e[11];
    const double c1 = e[8] * e[14] - e[12] * e[10];
    const double c0 = e[8] * e[13] - e[12] * e[9];

    const double d = s0 * c5 - s1 * c4 + s2 * c3 + s3 * c2 - s4 * c1 + s5 * c0;
    if (determinant)
        *determinant = static_cast<float>(d);
    const float reciprocal = static_cast<float>(1.0 / d);
    if (d == 0.0 || !std::isfinite(reciprocal))
        return nullptr;

    const double i = 1.0 / d;
    const double adjugate[16] = {
        e[5] * c5 - e[6] * c4 + e[7] * c3,     -e[1] * c5 + e[2] * c4 - e[3] * c3,
        e[13] * s5 - e[14] * s4 + e[15] * s3,  -e[9] * s5 + e[10] * s4 - e[11] * s3,
        -e[4] * c5 + e[6] * c2 - e[7] * c1,    e[0] * c5 - e[2] * c2 + e[3] * c1,
        -e[12] * s5 + e[14] * s2 - e[15] * s1, e[8] * s5 - e[10] * s2 + e[11] * s1,
        e[4] * c4 - e[5] * c2 + e[7] * c0,     -e[0] * c4 + e[1] * c2 - e[3] * c0,
        e[12] * s4 - e[13] * s2 + e[15] * s0,  -e[8] * s4 + e[9] * s2 - e[11] * s0,
        -e[4] * c3 + e[5] * c1 - e[6] * c0,    e[0] * c3 - e[1] * c1 + e[2] * c0,
        -e[12] * s3 + e[13] * s1 - e[14] * s0, e[8] * s3 - e[9] * s1 + e[10] * s0,
    };
    for (int k = 0; k < 16; ++k)
        out->m[k] = static_cast<float>(adjugate[k] * i);
    return out;
}

Mat4 Mat4InverseOrIdentity(const Mat4& m)
{
    Mat4 out = kMat4Identity;
    Mat4Inverse(&out, nullptr, &m);
    return out;
}

Vec3* TransformCoord(Vec3* out, const Vec3* v, const Mat4* m)
{
    if (!out || !v || !m)
        return nullptr;
    *out = TransformCoord(*v, *m);
    return out;
}

} // namespace gw
