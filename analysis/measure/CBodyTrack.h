#pragma once

#include "CLegTrack.h"
#include "Vec3.h"

#include <array>
#include <cstddef>
#include <optional>
#include <vector>

namespace gw {

class CNode;
class CPoseSampler;

/// The joints of one skeleton by which hips, trunk and hands are measured; null if not mapped.
struct BodyLandmarks
{
    std::vector<LegJoints> legs; ///< at most two
    CNode* neck = nullptr;       ///< the head's joint if no neck is mapped
    CNode* head = nullptr;       ///< null if it is used as the neck
    std::array<CNode*, 2> hands{};
};

/// The trunk in one pose.
struct TrunkLine
{
    Vec3 chord;  ///< from the midpoint of the hip joints to the neck
    Vec3 across; ///< from the last leg's hip joint to the first one's; zero with only one leg
};

/// The positions of these joints in each frame, in world space. The list of a missing joint is empty.
class CBodyTrack
{
public:
    /// The joints of one leg. Legs keep their order.
    struct Leg
    {
        std::vector<Vec3> hip;
        std::vector<Vec3> knee;
        std::vector<Vec3> ankle;
    };

    explicit CBodyTrack(BodyLandmarks joints);

    void WatchJoints(CPoseSampler& sampler) const;
    /// Adds the current pose as the next frame.
    void Append();
    /// Converts all positions to another unit.
    void Scale(double factor);

    size_t FrameCount() const { return m_kLegs.empty() ? m_kNeck.size() : m_kLegs[0].hip.size(); }
    const std::vector<Leg>& Legs() const { return m_kLegs; }
    const std::vector<Vec3>& Neck() const { return m_kNeck; }
    const std::vector<Vec3>& Head() const { return m_kHead; }
    const std::vector<Vec3>& Hand(size_t side) const { return m_kHands[side]; }

    /// Returns the midpoint of the hip joints in a frame. There must be a leg.
    Vec3 Hips(size_t frame) const;
    /// Returns the trunk in a frame, or in the rest pose. There must be a leg and a neck.
    TrunkLine Trunk(size_t frame) const;
    TrunkLine RestTrunk() const;

private:
    BodyLandmarks m_kJoints;
    std::vector<Leg> m_kLegs;
    std::vector<Vec3> m_kNeck;
    std::vector<Vec3> m_kHead;
    std::array<std::vector<Vec3>, 2> m_kHands;
};

} // namespace gw
