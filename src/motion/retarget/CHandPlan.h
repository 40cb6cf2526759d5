#pragma once

#include "CBandFit.h"
#include "Vec3.h"

#include <array>
#include <optional>
#include <vector>

namespace gw {

/// What of a body hands touch, and the hands: places by side. In millimetres of the target over its floor,
/// also those of the source.
struct TouchPoints
{
    std::array<Vec3, 2> hands{};
    std::array<Vec3, 2> hips{};
    std::array<Vec3, 2> knees{};
    Vec3 neck = kVec3Zero;
    Vec3 head = kVec3Zero; ///< its middle
};

/// How far a hand is to be moved so that it is as far from thighs, trunk, head, the other hand and the floor
/// as the source's is, where that touches them or nearly does.
class CHandPlan
{
public:
    /// Without a floor hands may go anywhere below the body.
    CHandPlan(size_t frameCount, double secondsPerFrame, bool hasFloor);

    /// Whether hands come near to something in a pose of the source.
    bool Touches(const TouchPoints& source) const;
    /// Takes the poses of a frame; the target's as it is so far. Frames may be left out.
    void Add(size_t frame, const TouchPoints& source, const TouchPoints& target);
    /// Finds the ways of both hands for all frames; to be called once.
    void Solve();
    Vec3 Way(size_t side, size_t frame) const { return m_kWays[side][frame]; }

private:
    struct Fit
    {
        CBandFit x;
        CBandFit y;
        CBandFit z;
    };
    void Pull(size_t side, size_t frame, double weight, const Vec3& way);

    bool m_bHasFloor;
    std::vector<Fit> m_kFits;
    std::array<std::vector<Vec3>, 2> m_kWays;
};

} // namespace gw
