#include "Vec3.h"

#include <cmath>

namespace gw {

double Vec3Length(const Vec3& v)
{
    return std::sqrt(Vec3Dot(v, v));
}

void Vec3Add(const Vec3& a, const Vec3& b, Vec3& out)
{
    out = a + b;
}

void Vec3Sub(const Vec3& a, const Vec3& b, Vec3& out)
{
    out = a - b;
}

void Vec3Scale(const Vec3& a, float s, Vec3& out)
{
    out = a * s;
}

void Vec3Scale(Vec3& a, float s)
{
    a = a * s;
}

Vec3 operator+(const Vec3& a, const Vec3& b)
{
    return {a.x + b.x, a.y + b.y, a.z + b.z};
}

Vec3 operator-(const Vec3& a, const Vec3& b)
{
    return {a.x - b.x, a.y - b.y, a.z - b.z};
}

Vec3 operator-(const Vec3& a)
{
    return {-a.x, -a.y, -a.z};
}

Vec3 operator*(const Vec3& a, float s)
{
    return {a.x * s, a.y * s, a.z * s};
}

double Vec3Dot(const Vec3& a, const Vec3& b)
{
    return static_cast<double>(a.x) * b.x + static_cast<double>(a.y) * b.y + static_cast<double>(a.z) * b.z;
}

Vec3 Vec3Cross(const Vec3& a, const Vec3& b)
{
    return {a.y * b.z - a.z * b.y, a.z * b.x - a.x * b.z, a.x * b.y - a.y * b.x};
}

Vec3 Vec3Normalized(const Vec3& v)
{
    const double length = Vec3Length(v);
    if (length == 0.0)
        return v;
    return {static_cast<float>(v.x / length), static_cast<float>(v.y / length),
            static_cast<float>(v.z / length)};
}

} // namespace gw
