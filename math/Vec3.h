#pragma once

namespace gw {

/// A point, direction or scale: three 32-bit floats. As a row it is multiplied from the left: p' = p · M.
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

/// sqrt(x·x + y·y + z·z).
double Vec3Length(const Vec3& v);
/// a + b into out, which may be an operand.
void Vec3Add(const Vec3& a, const Vec3& b, Vec3& out);
/// a - b into out, which may be an operand.
void Vec3Sub(const Vec3& a, const Vec3& b, Vec3& out);
/// a · s into out, which may be a.
void Vec3Scale(const Vec3& a, float s, Vec3& out);
/// a := a · s.
void Vec3Scale(Vec3& a, float s);

Vec3 operator+(const Vec3& a, const Vec3& b);
Vec3 operator-(const Vec3& a, const Vec3& b);
Vec3 operator-(const Vec3& a);
Vec3 operator*(const Vec3& a, float s);

/// a · b, in 64 bits.
double Vec3Dot(const Vec3& a, const Vec3& b);
/// a x b; kVec3UnitX x kVec3UnitY is kVec3UnitZ.
Vec3 Vec3Cross(const Vec3& a, const Vec3& b);
/// v divided by its length; a zero vector is answered as it is.
Vec3 Vec3Normalized(const Vec3& v);

} // namespace gw
