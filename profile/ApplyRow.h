#pragma once

#include <functional>

namespace gw {

class CBoneNames;
class CMapRowTable;
class CRetargeter;

/// Name of the target skeleton's share file, in the folder of base.htr.
inline constexpr const char* kShareFile = "KsBone.bsm";

/// The number of rows, including fixed ones, and how many of them find their bones.
struct RowMatch
{
    int rowCount = 0;
    int foundCount = 0;
    int mappedCount = 0;     ///< rows with a source
    bool drivesRoot = false; ///< an existing source bone drives the target's root bone

    /// Returns whether a conversion accepts the rows.
    bool IsWhole() const { return foundCount == rowCount && drivesRoot; }
};

/// Looks up the bones of all rows and returns how many match. If a retargeter is given, sets the values of
/// rows with existing bones that differ from its defaults. `onMapped` is called for each row that has a
/// source.
RowMatch ApplyRows(const CMapRowTable& rows, const CBoneNames& sources, const CBoneNames& targets,
                   CRetargeter* retargeter, const std::function<void(int row)>& onMapped = {});

} // namespace gw
