#include "CLegSolver.h"

namespace gw {

void CLegSolver::SetLimb(size_t k, const Vec3& upper, const Vec3& lower, const Vec3& axis,
                         const Vec3& projection)
{
    upperMatrix = lowerMatrix = kMat4Identity;
    upperMatrix.SetTranslation(TransformCoord(upper, AxisSwapForward));
    lowerMatrix.SetTranslation(TransformCoord(lower, AxisSwapForward));
    chains[k].Init(upperMatrix, lowerMatrix, axis, projection);
}

bool CLegSolver::Solve(size_t k, Vec3& hint, const Mat4& goal, Pose& pose)
{
    CLimbChain& chain = chains[k];
    chain.clampReach = true;
    if (!chain.SetGoal(goal))
        return false;
    hint = chain.KneePoint(chain.KneeAngleFromHint(hint));
    if (!chain.SolveAtAngle(chain.KneeAngleFromHint(hint), pose.hip, pose.foot))
        return false;
    pose.knee = Mat3FromAxisAngle(kneeAxis, chain.kneeAngle);
    return true;
}

} // namespace gw
