#pragma once

#include "CBodyMap.h"
#include "Mat3.h"

#include <optional>

namespace gw {

struct CReferencePose;

/// Returns the rotation from a foot's space to that of a standing foot: heading along +Z, sole normal along
/// +Y. `standing` is the normal in the foot's space measured from the motion. Without it, the current pose is
/// used, whose soles are assumed to be level if `isLevel` is set or the foot slopes like a standing one.
Mat3 FootTurn(const BodyLeg& leg, const CReferencePose& pose, const std::optional<Vec3>& standing,
              bool isLevel);

} // namespace gw
