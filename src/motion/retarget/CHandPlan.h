#pragma once

#include "CBandFit.h"
#include "Vec3.h"

#include <array>
#include <limits>
#include <optional>
#include <vector>

namespace gw {

/// The hands of a body and the points that hands touch; pairs are indexed by side. Positions are in
/// millimeters of the target, above its floor, for the source as well. Shoulders and reach matter only for
/// the target.
struct TouchPoints
{
    static constexpr double kNoLimit = std::numeric_limits<double>::infinity();

    std::array<Vec3, 2> hands{};
    std::array<Vec3, 2> hips{};
    std::array<Vec3, 2> knees{};
    Vec3 neck = kVec3Zero;
    Vec3 head = kVec3Zero; ///< middle of the head
    std::array<Vec3, 2> shoulders{};
    std::array<double, 2> reach{kNoLimit, kNoLimit}; ///< how far a hand can be from its shoulder
};

/// Plans how far to move each hand so that it keeps the source's distance to thighs, trunk, head, the other
/// hand and the floor, whenever the source's hand touches or nearly touches one of them.
class CHandPlan
{
public:
    /// Without a floor, the height of the hands is not limited.
    CHandPlan(size_t frameCount, double secondsPerFrame, bool hasFloor);

    /// Returns whether a hand touches or nearly touches something in a pose of the source.
    bool Touches(const TouchPoints& source) const;
    /// Adds the poses of a frame: the source's, and the target's before its hands are moved. Frames may be
    /// skipped.
    void Add(size_t frame, const TouchPoints& source, const TouchPoints& target);
    /// Computes the corrections of both hands for all frames. Call it only once, after the last Add.
    void Solve();
    /// Returns how far to move a hand in a frame, in millimeters. Call it only after Solve.
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
