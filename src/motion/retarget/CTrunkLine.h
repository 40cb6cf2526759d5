#pragma once

#include "Vec3.h"

#include <array>
#include <vector>

namespace gw {

class CNode;

/// The line of a source's trunk, from the midpoint of its hip joints along the spine up to the neck.
class CTrunkLine
{
public:
    CTrunkLine() = default;
    /// `top` is the neck or a joint above it. The spine consists of the joints between `hips` and `top`. The
    /// line stays empty if a joint is null or if `top` is not below `hips` in the tree.
    CTrunkLine(const std::array<CNode*, 2>& thighs, CNode* hips, CNode* top);

    /// Returns whether there is a line.
    bool IsWhole() const { return m_kSpine.size() > 0; }
    /// Returns the joints that are read.
    std::vector<CNode*> Joints() const;
    /// Reads the joints' current positions. Returns false if the line has no finite length above 0. Call it
    /// only if IsWhole.
    bool Read();
    /// Returns the vector from the second hip joint to the first; not normalized.
    Vec3 Across() const { return m_kAcross; }
    /// Returns the world position at a fraction, 0 to 1, of the line's length, counted from the hips.
    Vec3 At(double share) const;

private:
    std::array<CNode*, 2> m_apkThighs{};
    std::vector<CNode*> m_kSpine; // above the hips, including the top
    Vec3 m_kAcross = kVec3Zero;
    std::vector<Vec3> m_kPoints;
    std::vector<double> m_kArc; // distance of each point from the hips, along the line
};

} // namespace gw
