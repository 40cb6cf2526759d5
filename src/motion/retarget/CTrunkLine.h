#pragma once

#include "Vec3.h"

#include <array>
#include <vector>

namespace gw {

class CNode;

/// The line of a source's trunk: from the middle of its hip joints along its spine up to its neck.
class CTrunkLine
{
public:
    CTrunkLine() = default;
    /// `top` is the neck, or a joint above it; the spine is what lies between it and `hips`.
    CTrunkLine(const std::array<CNode*, 2>& thighs, CNode* hips, CNode* top);

    /// Whether there is a line.
    bool IsWhole() const { return m_kSpine.size() > 0; }
    /// The joints that are looked at.
    std::vector<CNode*> Joints() const;
    /// Takes the joints' present places. False for a line without a length.
    bool Read();
    /// The direction from the second hip joint to the first; not normalized.
    Vec3 Across() const { return m_kAcross; }
    /// The point at a share, 0 to 1, of the line's length from the hips up.
    Vec3 At(double share) const;

private:
    std::array<CNode*, 2> m_apkThighs{};
    std::vector<CNode*> m_kSpine; // above the hips, the top included
    Vec3 m_kAcross = kVec3Zero;
    std::vector<Vec3> m_kPoints;
    std::vector<double> m_kArc; // how far along the line each point lies
};

} // namespace gw
