#pragma once

#include <cmath>

namespace gw {

/// A point, direction or scale: three 32-bit floats. As a row vector it is multiplied from the left: p' = p ·
/// M.
struct Vec3
{
    float x;
    float y;
    float z;

    /// Exact comparison, element by element.
    friend bool operator==(const Vec3&, const Vec3&) = default;
};

inline constexpr Vec3 kVec3Zero{0.0f, 0.0f, 0.0f};
inline constexpr Vec3 kVec3One{1.0f, 1.0f, 1.0f};
inline constexpr Vec3 kVec3UnitX{1.0f, 0.0f, 0.0f};
inline constexpr Vec3 kVec3UnitY{0.0f, 1.0f, 0.0f};
inline constexpr Vec3 kVec3UnitZ{0.0f, 0.0f, 1.0f};

// Small operations are defined inline: they run for every bone and frame, and a call would cost more than the
// operation.

inline Vec3 operator+(const Vec3& a, const Vec3& b)
{
    return {a.x + b.x, a.y + b.y, a.z + b.z};
}

inline Vec3 operator-(const Vec3& a, const Vec3& b)
{
    return {a.x - b.x, a.y - b.y, a.z - b.z};
}

inline Vec3 operator-(const Vec3& a)
{
    return {-a.x, -a.y, -a.z};
}

inline Vec3 operator*(const Vec3& a, float s)
{
    return {a.x * s, a.y * s, a.z * s};
}

/// Returns a · b, computed in 64 bits.
inline double Vec3Dot(const Vec3& a, const Vec3& b)
{
    return static_cast<double>(a.x) * b.x + static_cast<double>(a.y) * b.y + static_cast<double>(a.z) * b.z;
}

/// Returns sqrt(x·x + y·y + z·z).
inline double Vec3Length(const Vec3& v)
{
    return std::sqrt(Vec3Dot(v, v));
}

/// Returns v divided by a length, in 64 bits; v itself if the length is 0.
inline Vec3 Vec3DividedBy(const Vec3& v, double length)
{
    if (length == 0.0)
        return v;
    return {static_cast<float>(v.x / length), static_cast<float>(v.y / length),
            static_cast<float>(v.z / length)};
}

/// Returns v divided by its length; a zero vector is returned unchanged.
inline Vec3 Vec3Normalized(const Vec3& v)
{
    return Vec3DividedBy(v, Vec3Length(v));
}

/// out := a + b; out may be an operand.
void Vec3Add(const Vec3& a, const Vec3& b, Vec3& out);
/// out := a - b; out may be an operand.
void Vec3Sub(const Vec3& a, const Vec3& b, Vec3& out);
/// out := a · s; out may be a.
void Vec3Scale(const Vec3& a, float s, Vec3& out);
/// a := a · s.
void Vec3Scale(Vec3& a, float s);
/// Returns a x b; kVec3UnitX x kVec3UnitY is kVec3UnitZ.
Vec3 Vec3Cross(const Vec3& a, const Vec3& b);

} // namespace gw
