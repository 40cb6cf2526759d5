// A boxer stands on the balls of his feet with his heels up by a few centimeters. A foot of another length
// that keeps the source's rotation has its heel higher or lower than that. In many recordings, the toe joint
// even sinks into the floor when the heel comes up, because the foot rotates about a point in front of it,
// and a target whose toe stays on the floor would have its whole leg lifted. A viewer sees how high the heel
// is, and he sees a leg that is lifted or a knee that bends, long before he sees how steep the foot is.
//
// So a foot that stands has its toe on the floor and its ankle about as high as the source's, and its pitch
// follows from that. A few millimeters are left to what keeps the foot from sliding. The faster the foot
// moves, the less all this counts: a swinging foot rotates like the source's.

#include "SettleFoot.h"

#include "CBandFit.h"
#include "Figures.h"

#include <cmath>

namespace gw {

namespace {

constexpr double kMostSettle = 0.5;  // radians, softly; a source that needs more has no usual foot
constexpr double kNoticed = 35.0;    // millimeters by which a heel is clearly too high or too low
constexpr double kSettleHertz = 2.0; // of the changes
constexpr double kSwingWeight = 0.1; // weight of the source's rotation; the height of a still foot has 1

} // namespace

std::vector<double> SettleFoot(std::span<const ToeWish> wishes, double secondsPerFrame)
{
    CBandFit drops(wishes.size(), BendWeight(kSettleHertz, secondsPerFrame), kSwingWeight);
    for (size_t frame = 0; frame < wishes.size(); ++frame)
    {
        const ToeWish& wish = wishes[frame];
        const double most = kMostSettle * Vec3Length(wish.toe);
        const double drop = wish.below + static_cast<double>(wish.toe.y);
        const double noticed = Smoothstep(std::fabs(drop) / kNoticed);
        drops.AddValue(frame, wish.settled, most * std::tanh(noticed * drop / most));
    }
    return drops.Solve();
}

} // namespace gw
