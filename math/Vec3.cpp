#include "Vec3.h"

namespace gw {

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

Vec3 Vec3Cross(const Vec3& a, const Vec3& b)
{
    return {a.y * b.z - a.z * b.y, a.z * b.x - a.x * b.z, a.x * b.y - a.y * b.x};
}

} // namespace gw
