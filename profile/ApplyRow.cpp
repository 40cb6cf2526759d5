#include "ApplyRow.h"

#include "CMapRowTable.h"
#include "CRetargeter.h"
#include "FindBone.h"

namespace gw {

namespace {

Vec3 Degrees(const CRowNumbers& numbers)
{
    const auto& [x, y, z] = numbers.rotation;
    return {static_cast<float>(x), static_cast<float>(y), static_cast<float>(z)};
}

void SetMapping(CRetargeter& retargeter, CNode* target, CNode* source, const CRowNumbers& numbers)
{
    retargeter.SetSourceOf(target, source);
    const Vec3 degrees = Degrees(numbers);
    if (degrees != kVec3Zero)
        retargeter.SetOffsetAngles(target, degrees);
    const Mat3 axes = AxisMatrix(numbers.axes);
    if (axes != kMat3Identity)
        retargeter.SetOffsetMatrix(target, axes);
}

} // namespace

ERowFit ApplyRow(const CMapRowTable& rows, int row, const CBoneNames& sources, const CBoneNames& targets,
                 CRetargeter* retargeter)
{
    CNode* target = targets.Find(rows.Text(row, kTargetColumn));
    if (!target)
        return ERowFit::Missing;
    if (rows.IsFixed(row))
    {
        if (retargeter)
            retargeter->SetFixed(target, true);
        return ERowFit::Fixed;
    }
    CNode* source = sources.Find(rows.Text(row, kSourceColumn));
    if (!source)
        return ERowFit::Missing;
    if (retargeter)
        SetMapping(*retargeter, target, source, rows.Numbers(row));
    return ERowFit::Mapped;
}

} // namespace gw
