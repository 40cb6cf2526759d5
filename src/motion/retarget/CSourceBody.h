#pragma once

#include "CFeetTrack.h"

#include <vector>

namespace gw {

class CNode;

/// The motion of a source's root, hips and feet, frame by frame.
class CSourceBody
{
public:
    /// `root` is the joint that drives the target's root, or null if nothing does. The tree must be in rest
    /// pose.
    CSourceBody(const CNode* root, const std::vector<LegJoints>& legs);

    /// Returns the joints of the legs.
    std::vector<CNode*> Joints() const;
    /// Adds the current pose as the next frame. The first frame also sets the length of the legs.
    void Append();

    size_t FrameCount() const { return m_kRoots.size(); }
    /// Returns the mean length of the legs, in the source's units.
    double LegLength() const { return m_kFeet.LegLength(); }
    /// Returns the world position of the root; zero if there is none.
    const Vec3& Root(size_t frame) const { return m_kRoots[frame]; }
    /// Returns the world position of the midpoint of the hip joints.
    const Vec3& Hips(size_t frame) const { return m_kHips[frame]; }
    const CLegTrack& Leg(size_t leg) const { return m_kFeet.Legs()[leg]; }

    /// Returns the level on which the soles stand, in the source's units; NaN for a skeleton without toes.
    /// Toe joints are at least `leastToe` above their soles.
    float Floor(double leastToe) const;

    /// Finds when the feet touch the floor and where the source jumps. Call it after the last frame; what
    /// follows needs it.
    void FindTouches(double secondsPerFrame);
    /// Returns the touches of each leg. They are empty, and nothing has landed, if the legs have no length.
    const std::vector<FootTouches>& Touches() const { return m_kTouches; }
    /// Returns the frames after which the hips or an ankle jump: from a stance before the recording to its
    /// start, for example, or from one take to the next.
    const std::vector<size_t>& Jumps() const { return m_kJumps; }
    /// Returns the height of the ankle above the toe in a foot that stands flat, measured while feet stand.
    float FlatDrop() const;

private:
    bool HasLegs() const;

    const CNode* m_pkRoot;
    std::vector<LegJoints> m_kLegs;
    CFeetTrack m_kFeet;
    std::vector<Vec3> m_kRoots;
    std::vector<Vec3> m_kHips;
    std::vector<FootTouches> m_kTouches;
    std::vector<size_t> m_kJumps;
};

} // namespace gw
