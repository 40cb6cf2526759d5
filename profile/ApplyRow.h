#pragma once

#include <cstdint>

namespace gw {

class CBoneNames;
class CMapRowTable;
class CRetargeter;

/// What became of a row.
enum class ERowFit : uint8_t
{
    Missing, ///< a bone of the row is in no skeleton: nothing was set
    Fixed,   ///< the target bone takes no source
    Mapped,  ///< source and target are there
};

/// Looks up the bones of a row and, where a retargeter is given, tells it what the row says: only what
/// differs from the retargeter's defaults.
ERowFit ApplyRow(const CMapRowTable& rows, int row, const CBoneNames& sources, const CBoneNames& targets,
                 CRetargeter* retargeter);

} // namespace gw
