// Contacts determine the steps of the ankle (StandSteps), not its positions. The positions follow by least
// squares over all frames: match the steps of the contacts, stay close to the free path, and do not change
// the offset from it suddenly. One solution gives each contact its position and blends the swing between two
// contacts. If the source's hips shake, the feet keep that shaking: feet held still below shaking hips would
// make the legs shake instead.

#include "HoldFoot.h"

#include "Angles.h"
#include "CBandFit.h"

#include <cmath>

namespace gw {

namespace {

constexpr double kReturnHertz = 2.0;  // of the return to the free path, which then takes 0.2 s
constexpr double kHoldSeconds = 10.0; // how long a foot that is held off its free path takes to creep back
constexpr double kShakeHertz = 6.0;   // faster shaking of hips, legs and feet is left in the foot

} // namespace

std::vector<Vec3> HoldFoot(std::span<const Vec3> free, std::span<const Vec3> steps,
                           std::span<const Contact> contacts, double secondsPerFrame)
{
    const double bend = BendWeight(kReturnHertz, secondsPerFrame);
    const double stepWeight = std::pow(kHoldSeconds / secondsPerFrame, 2.0);
    const double shakeWeight = stepWeight * std::pow(kTwoPi64 * kShakeHertz * secondsPerFrame, -2.0);
    CBandFit x(free.size(), bend, 1.0);
    CBandFit z(free.size(), bend, 1.0);
    for (const Contact& contact : contacts)
    {
        const auto end = static_cast<size_t>(contact.end);
        for (auto frame = static_cast<size_t>(contact.first); frame + 1 < end; ++frame)
        {
            const Vec3 step = steps[frame] - (free[frame + 1] - free[frame]);
            x.AddStep(frame, stepWeight, static_cast<double>(step.x));
            z.AddStep(frame, stepWeight, static_cast<double>(step.z));
            if (frame + 2 < end)
            {
                x.AddBend(frame, shakeWeight);
                z.AddBend(frame, shakeWeight);
            }
        }
    }
    const std::vector<double> offX = x.Solve();
    const std::vector<double> offZ = z.Solve();
    std::vector<Vec3> path(free.begin(), free.end());
    for (size_t frame = 0; frame < path.size(); ++frame)
        path[frame] =
            path[frame] + Vec3{static_cast<float>(offX[frame]), 0.0f, static_cast<float>(offZ[frame])};
    return path;
}

} // namespace gw
