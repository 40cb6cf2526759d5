#pragma once

#include "BodyStance.h"

#include <array>

namespace gw {

class CJointTree;

/// The joints of two legs and of the trunk's ends, by index; -1 if missing.
struct LegsOfBody
{
    struct Leg
    {
        int thigh = -1;
        int knee = -1;
        int ankle = -1;
        int toe = -1; ///< or the joint below the ankle
    };
    int hip = -1;
    int chest = -1;          ///< or the head, if present
    std::array<Leg, 2> legs; ///< left before right, as far as known
    bool standsAtRest = false;
};
/// Returns the joint indices of a body's legs and trunk.
LegsOfBody LegsOf(const CJointTree& tree, const CBodyMap& body);

/// Returns the stance in a pose of a tree.
BodyStance StanceIn(const CJointTree& tree, size_t stance, const CBodyMap& body);

/// Returns how certain it is that the first leg is the left one, from -1 to 1 (negative: it is the right
/// one), by up x forward. Forward is where the feet point, otherwise where the knees bend. A mean over all
/// poses that show anything; 0 if none does.
double JudgeSides(const CJointTree& tree, const LegsOfBody& body);
/// A verdict of JudgeSides or JudgeAlong is certain if its absolute value is above this.
inline constexpr double kSidesSure = 0.3;

/// Same for a pair of joints that should be on the same sides as the thighs.
double JudgeAlong(const CJointTree& tree, const LegsOfBody& body, int first, int second);

} // namespace gw
