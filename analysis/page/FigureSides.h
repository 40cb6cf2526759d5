#pragma once

#include "ConversionMeasures.h"

#include <cstdint>
#include <string>
#include <unordered_map>
#include <vector>

namespace gw {

class CNode;

/// The side of the body that a bone belongs to; its bones have their own color.
enum class EFigureSide : uint8_t
{
    Middle,
    Left,
    Right,
};

/// Returns the name of a side: "middle", "left" or "right".
const char* FigureSideName(EFigureSide side);

/// Returns the sides of nodes, parents before children, by the bones of the host skeleton that they drive or
/// are. `name` selects the names of this tree's bones. A node that is not a mapped bone is on its parent's
/// side.
std::vector<EFigureSide> FigureSides(const std::vector<CNode*>& nodes, const std::vector<BoneMeasures>& bones,
                                     std::string BoneMeasures::*name);

} // namespace gw
