#include "JointRows.h"

#include "Angles.h"
#include "AxisRotation.h"
#include "BVHOutline.h"
#include "CRowTable.h"
#include "TKBVHFile.h"

#include <algorithm>

namespace gw {

namespace {

bool IsRotation(int channel)
{
    return channel >= kFirstRotation && channel < kFirstScale;
}

Quat RotationIn(const OutlineJoint& joint, const CRowTable& table, size_t row)
{
    CAxisRotation rotation;
    for (size_t i = 0; i < joint.channels.size(); ++i)
    {
        if (IsRotation(joint.channels[i]))
            rotation.RotateRows(static_cast<size_t>(joint.channels[i] - kFirstRotation),
                                table.At(row, joint.firstColumn + i) * kDegreesToRadians);
    }
    return QuatFromMat3(rotation.Matrix());
}

} // namespace

bool PositionColumns(const OutlineJoint& joint, std::array<size_t, 3>& columns)
{
    for (int axis = 0; axis < 3; ++axis)
    {
        const auto found = std::ranges::find(joint.channels, axis);
        if (found == joint.channels.end())
            return false;
        columns[static_cast<size_t>(axis)] =
            joint.firstColumn + static_cast<size_t>(found - joint.channels.begin());
    }
    return true;
}

Vec3 PositionIn(const CRowTable& table, size_t row, const std::array<size_t, 3>& columns)
{
    return {table.At(row, columns[0]), table.At(row, columns[1]), table.At(row, columns[2])};
}

std::vector<size_t> RotationColumns(const OutlineJoint& joint)
{
    std::vector<size_t> columns;
    for (size_t i = 0; i < joint.channels.size(); ++i)
    {
        if (IsRotation(joint.channels[i]))
            columns.push_back(joint.firstColumn + i);
    }
    return columns;
}

std::vector<Quat> RotationsOf(const OutlineJoint& joint, const CRowTable& table)
{
    std::vector<Quat> rotations;
    rotations.reserve(table.RowCount());
    for (size_t row = 0; row < table.RowCount(); ++row)
        rotations.push_back(RotationIn(joint, table, row));
    return rotations;
}

} // namespace gw
