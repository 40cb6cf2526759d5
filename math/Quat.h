#pragma once

#include "Mat3.h"

namespace gw {

/// A rotation: four floats in the order w, x, y, z, in memory, in files and in every argument.
struct Quat
{
    float w;
    float x;
    float y;
    float z;

    /// The imaginary part.
    Vec3 Imaginary() const { return {x, y, z}; }
    /// Exact comparison, element by element; q and -q are the same rotation and compare unequal.
    friend bool operator==(const Quat&, const Quat&) = default;
};

inline constexpr Quat kQuatIdentity{1.0f, 0.0f, 0.0f, 0.0f};
inline constexpr Quat kQuatZero{0.0f, 0.0f, 0.0f, 0.0f};

/// All four components times s, with no renormalisation.
void QuatScale(const Quat& q, float s, Quat& out);
/// The matrix of a unit quaternion; the norm is not divided out.
void QuatToMat3(const Quat& q, Mat3& out);
Mat3 QuatToMat3(const Quat& q);
/// The quaternion of a matrix with orthonormal rows; the rows are not made so here.
void QuatFromMat3(Quat& out, const Mat3& m);
Quat QuatFromMat3(const Mat3& m);
/// From a at t = 0 to b at t = 1 the short way round. t is not clamped, the result is not normalised.
void QuatSlerp(Quat& out, float t, const Quat& a, const Quat& b);
Quat QuatSlerp(float t, const Quat& a, const Quat& b);

} // namespace gw
