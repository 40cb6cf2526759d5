#pragma once

#include <functional>

namespace gw {

class CBoneNames;
class CMapRowTable;
class CRetargeter;

/// The target skeleton's shares, in the folder of base.htr.
inline constexpr const char* kShareFile = "KsBone.bsm";

/// How many rows there are, fixed ones included, and how many find their bones.
struct RowMatch
{
    int rowCount = 0;
    int foundCount = 0;
    int mappedCount = 0;     ///< those of them that have a source
    bool drivesRoot = false; ///< a source bone that is there drives the target's root bone

    /// Whether a conversion accepts the rows.
    bool IsWhole() const { return foundCount == rowCount && drivesRoot; }
};

/// Looks up the bones of all rows. Tells a retargeter, unless it is null, what those say whose bones are
/// there: only what differs from its defaults. `onMapped` is called for each of them that has a source.
RowMatch ApplyRows(const CMapRowTable& rows, const CBoneNames& sources, const CBoneNames& targets,
                   CRetargeter* retargeter, const std::function<void(int row)>& onMapped = {});

} // namespace gw
