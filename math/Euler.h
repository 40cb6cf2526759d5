#pragma once

#include "Mat4.h"

#include <string_view>

namespace gw {

/// Rotation orders. A name of letters A, B, C means R_C · R_B · R_A: the last letter acts first on a row
/// vector.
enum class EEulerOrder : int
{
    XYZ, ///< Rz · Ry · Rx
    ZYX, ///< Rx · Ry · Rz
    XZY, ///< Ry · Rz · Rx
    YZX, ///< Rx · Rz · Ry
    ZXY, ///< Ry · Rx · Rz
    YXZ, ///< Rz · Rx · Ry
};

/// Returns the matrix of three angles in degrees about X, Y and Z. `order` is one of the six names in
/// capitals; any other text yields the identity.
Mat3 EulerToMat3(std::string_view order, const Vec3& degrees);

/// Computes the angles in radians about X, Y and Z that produce m in an order from 0 to 5 (EEulerOrder). For
/// any other order, x, y and z are left unchanged.
void Mat3ToEuler(const Mat3& m, int order, float& x, float& y, float& z);

/// Computes the angles in degrees about X, Y and Z of a "ZYX" matrix, without a gimbal branch; x and z can
/// reach 270. A quotient 0 / 0 counts as 0.
void Mat3ToEulerDegrees(const Mat3& m, float& x, float& y, float& z);
Vec3 Mat3ToEulerDegrees(const Mat3& m);
/// Same as Mat3ToEulerDegrees of the normalized rows of m, bit for bit, but with only the divisions it needs.
/// `rowLength0` is the length of row 0.
Vec3 RowsToEulerDegrees(const Mat4& m, double rowLength0);

/// Returns the angles in degrees about X, Y and Z, from -180 to 180, that reproduce a "ZYX" matrix in every
/// case. Near a quarter turn about Y, where the X and Z angles are ambiguous, one compensates for the other.
Vec3 EulerDegreesZYX(const Mat3& m);

/// Returns the rotation from +Y to a file's bone axis 'X' or 'Z'; the identity for any other letter.
Mat3 UpAxisMatrix(char letter);

} // namespace gw
