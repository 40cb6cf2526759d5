#pragma once

#include "CBodyMap.h"
#include "Mat3.h"

namespace gw {

struct CReferencePose;

/// What turns a posed hand to one that lies along its arm in a T-pose, palm down. `start` turns the forearm
/// so; without fingers or an end the hand goes along with it.
Mat3 HandTurn(const CNode& hand, EBodySide side, const CReferencePose& pose, const Mat3& start);

} // namespace gw
