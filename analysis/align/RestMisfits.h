#pragma once

#include <string>
#include <vector>

namespace gw {

class CNode;
class CRetargeter;

/// A target bone that the source's rest pose would turn away from the target's, and by how many degrees.
struct RestMisfit
{
    std::string target;
    std::string source;
    double degrees = 0.0;
};

/// The limbs and the neck that a retargeter's rows, offsets and all, turn by more than a profile would mean
/// to when the source stands at rest. Trees need not be posed.
std::vector<RestMisfit> FindRestMisfits(const CRetargeter& table, CNode& targetRoot);

} // namespace gw
