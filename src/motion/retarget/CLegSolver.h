#pragma once

#include "CLimbChain.h"

#include <cstddef>
#include <vector>

namespace gw {

/// One limb solver per leg.
class CLegSolver
{
public:
    /// The rotations that move a limb's end to its goal, in the solver's frame.
    struct Pose
    {
        Mat3 hip;
        Mat3 knee;
        Mat3 foot;
    };

    explicit CLegSolver(size_t legCount) : chains(legCount) {}

    /// Sets up leg k: its segments in the bones' frame, the hinge axis and the projection axis in the
    /// solver's frame.
    void SetLimb(size_t k, const Vec3& upper, const Vec3& lower, const Vec3& axis, const Vec3& projection);
    /// Solves leg k for a goal. Returns false if no knee angle reaches it. The hint is moved onto the knee's
    /// circle.
    bool Solve(size_t k, Vec3& hint, const Mat4& goal, Pose& pose);

private:
    Mat4 lowerMatrix = kMat4Identity;
    Mat4 upperMatrix = kMat4Identity;
    Vec3 kneeAxis = kVec3UnitY;
    std::vector<CLimbChain> chains;
};

} // namespace gw
