#pragma once

#include "Mat4.h"

#include <string_view>

namespace gw {

/// Rotation orders. A string of the letters A, B, C means R_C · R_B · R_A: the last letter acts first on a
/// row.
enum class EEulerOrder : int
{
    XYZ, ///< Rz · Ry · Rx
    ZYX, ///< Rx · Ry · Rz
    XZY, ///< Ry · Rz · Rx
    YZX, ///< Rx · Rz · Ry
    ZXY, ///< Ry · Rx · Rz
    YXZ, ///< Rz · Rx · Ry
};

/// The matrix of three angles in degrees about X, Y and Z. The order is one of the six names in capitals; any
/// other text gives the identity.
Mat3 EulerToMat3(std::string_view order, const Vec3& degrees);

/// The angles in radians about X, Y and Z that give m in an order of 0 to 5 (EEulerOrder). A higher order
/// writes nothing.
void Mat3ToEuler(const Mat3& m, int order, float& x, float& y, float& z);

/// The angles in degrees about X, Y and Z of a "ZYX" matrix, with no gimbal branch; x and z may reach 270. A
/// quotient of 0 by 0 counts as 0.
void Mat3ToEulerDegrees(const Mat3& m, float& x, float& y, float& z);
Vec3 Mat3ToEulerDegrees(const Mat3& m);
/// The same for the normalized rows of a transform, bit for bit, with only as many divisions as that takes.
/// The caller knows the length of row 0.
Vec3 RowsToEulerDegrees(const Mat4& m, double rowLength0);

/// The angles in degrees about X, Y and Z, -180 to 180, that give a "ZYX" matrix back in every case: near a
/// quarter turn about Y, where those of X and Z run into each other, one takes up what the other is off.
Vec3 EulerDegreesZYX(const Mat3& m);

/// What turns +Y into a file's bone axis: 'X', 'Z', or the identity for any other letter.
Mat3 UpAxisMatrix(char letter);

} // namespace gw
