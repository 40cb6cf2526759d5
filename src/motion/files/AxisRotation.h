#pragma once

#include "Mat3.h"

#include <array>
#include <cmath>
#include <cstddef>

namespace gw {

/// A rotation built up axis by axis, for the inner loops of the readers. Each step changes only two rows, a
/// third of a matrix product. Rows are padded to four floats, so a step takes only a few vector instructions.
class CAxisRotation
{
public:
    CAxisRotation() : CAxisRotation(kMat3Identity) {}
    explicit CAxisRotation(const Mat3& m)
    {
        for (size_t row = 0; row < 3; ++row)
            m_kRows[row] = {m.m[3 * row], m.m[3 * row + 1], m.m[3 * row + 2], 0.0f};
    }

    /// M := R · M, where R is the rotation about one axis (0 X, 1 Y, 2 Z) by an angle in radians. Same result
    /// as Mat3FromAxisAngle and Mat3Multiply, within rounding.
    void RotateRows(size_t axis, float radians)
    {
        const float c = std::cos(radians);
        const float s = std::sin(radians);
        const Row a = m_kRows[kNextAxis[axis]];
        const Row b = m_kRows[kNextAxis[axis + 1]];
        Row& newA = m_kRows[kNextAxis[axis]];
        for (size_t column = 0; column < a.size(); ++column)
            newA[column] = c * a[column] + s * b[column];
        Row& newB = m_kRows[kNextAxis[axis + 1]];
        for (size_t column = 0; column < a.size(); ++column)
            newB[column] = c * b[column] - s * a[column];
    }

    Mat3 Matrix() const
    {
        Mat3 m;
        for (size_t row = 0; row < 3; ++row)
            m.SetRow(static_cast<int>(row), {m_kRows[row][0], m_kRows[row][1], m_kRows[row][2]});
        return m;
    }

private:
    using Row = std::array<float, 4>;

    static constexpr size_t kNextAxis[] = {1, 2, 0, 1};

    alignas(16) std::array<Row, 3> m_kRows;
};

} // namespace gw
