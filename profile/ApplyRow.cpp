#include "ApplyRow.h"

#include "CMapRowTable.h"
#include "CRetargeter.h"
#include "FindBone.h"
#include "HostBones.h"
#include "Text.h"

#include <cstdint>

namespace gw {

namespace {

enum class ERowFit : uint8_t
{
    Missing, // a bone of the row is not in its skeleton; nothing was set
    Fixed,   // the target bone has no source
    Mapped,  // source and target were found
};

Vec3 Degrees(const RowNumbers& numbers)
{
    const auto& [x, y, z] = numbers.rotation;
    return {static_cast<float>(x), static_cast<float>(y), static_cast<float>(z)};
}

void SetMapping(CRetargeter& retargeter, CNode* target, CNode* source, const RowNumbers& numbers)
{
    retargeter.SetSourceOf(target, source);
    const Vec3 degrees = Degrees(numbers);
    if (degrees != kVec3Zero)
        retargeter.SetOffsetAngles(target, degrees);
    const Mat3 axes = AxisMatrix(numbers.axes);
    if (axes != kMat3Identity)
        retargeter.SetOffsetMatrix(target, axes);
}

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

} // namespace

RowMatch ApplyRows(const CMapRowTable& rows, const CBoneNames& sources, const CBoneNames& targets,
                   CRetargeter* retargeter, const std::function<void(int row)>& onMapped)
{
    RowMatch match;
    for (int row = 0; row < rows.RowCount(); ++row)
    {
        const ERowFit fit = ApplyRow(rows, row, sources, targets, retargeter);
        ++match.rowCount;
        match.foundCount += fit == ERowFit::Missing ? 0 : 1;
        match.mappedCount += fit == ERowFit::Mapped ? 1 : 0;
        if (fit == ERowFit::Mapped && onMapped)
            onMapped(row);
        if (EqualNoCase(rows.Text(row, kTargetColumn), kRootBone))
            match.drivesRoot = fit == ERowFit::Mapped;
    }
    return match;
}

} // namespace gw
