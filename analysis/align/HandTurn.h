#pragma once

#include "CBodyMap.h"
#include "Mat3.h"

namespace gw {

struct CReferencePose;

/// Returns the rotation from a posed hand to one in line with its arm in a T-pose, palm down. `start` does
/// the same for the forearm; a hand without fingers or an end follows it.
Mat3 HandTurn(const CNode& hand, EBodySide side, const CReferencePose& pose, const Mat3& start);

} // namespace gw
