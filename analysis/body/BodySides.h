#pragma once

#include "BodyStance.h"

#include <array>

namespace gw {

class CJointTree;

/// The joints of two legs and of the trunk's ends, by index; -1 for what is not there.
struct LegsOfBody
{
    struct Leg
    {
        int thigh = -1;
        int knee = -1;
        int ankle = -1;
        int toe = -1; ///< or the joint that is below the ankle
    };
    int hip = -1;
    int chest = -1;          ///< or the head, where there is one
    std::array<Leg, 2> legs; ///< the left one first, as far as is known
    bool standsAtRest = false;
};
LegsOfBody LegsOf(const CJointTree& tree, const CBodyMap& body);

/// The stance in a pose of a tree.
BodyStance StanceIn(const CJointTree& tree, size_t stance, const CBodyMap& body);

/// How surely the first leg is the left one, -1 to 1, by up x forward: forward is where the feet point, else
/// where the knees bend to. A mean over all poses that say something; below 0 the second leg is the left one.
/// 0 where none says anything.
double JudgeSides(const CJointTree& tree, const LegsOfBody& body);
/// From here on, either way, a verdict of JudgeSides or JudgeAlong is sure.
inline constexpr double kSidesSure = 0.3;

/// The same for a pair of joints that should lie to the same sides as the thighs.
double JudgeAlong(const CJointTree& tree, const LegsOfBody& body, int first, int second);

} // namespace gw
