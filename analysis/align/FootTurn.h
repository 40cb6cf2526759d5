#pragma once

#include "CBodyMap.h"
#include "Mat3.h"

#include <optional>

namespace gw {

struct CReferencePose;

/// What turns the space of a foot to that of a foot that stands: heading along +Z, sole's normal along +Y.
/// `standing` is the normal in the foot's space as the motion tells it; without one the present pose does,
/// whose soles are taken to be level where `isLevel` says so or the foot slopes as one does that stands.
Mat3 FootTurn(const BodyLeg& leg, const CReferencePose& pose, const std::optional<Vec3>& standing,
              bool isLevel);

} // namespace gw
