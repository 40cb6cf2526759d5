#pragma once

#include <string>
#include <vector>

namespace gw {

class CNode;
class CRetargeter;

/// A target bone that the source's rest pose would rotate away from the target's, and the angle in degrees.
struct TurnedBone
{
    std::string target;
    std::string source;
    double degrees = 0.0;
};

/// Returns the limbs, and the neck, that a retargeter's rows with their offsets rotate by more than a profile
/// would intend in the source's rest pose. Trees need not be posed.
std::vector<TurnedBone> FindTurnedBones(const CRetargeter& table, CNode& targetRoot);

} // namespace gw
