#pragma once

#include "JointRoles.h"
#include "Mat3.h"

#include <vector>

namespace gw {

class CMotionEvidence;
class CTreePoser;
struct CReferencePose;

/// Returns the rotations A of all joints (JointAlignment) that make a posed figure stand in a T-pose, facing
/// +Z, with its bones along the axes. The tree must be in the reference pose; `isRest` means that this is the
/// zero pose.
std::vector<Mat3> FindJointTurns(const CTreePoser& tree, const std::vector<JointRole>& roles,
                                 const CBodyMap& body, const CReferencePose& pose,
                                 const CMotionEvidence& evidence, bool isRest);

} // namespace gw
