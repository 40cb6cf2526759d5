#pragma once

#include "CLegTrack.h"
#include "CPoseMatcher.h"
#include "YieldKnee.h"

#include <optional>
#include <vector>

namespace gw {

/// One leg of the target that keeps to its source's: which bones make it, how long they are, and what source
/// and target do frame by frame.
class CFaithfulLeg
{
public:
    /// World directions; lengths of the target.
    struct Frame
    {
        Vec3 thigh;           ///< unit direction of the source from hip to knee
        Vec3 shin;            ///< unit direction of the source from knee to ankle
        Vec3 hip = kVec3Zero; ///< the target's hip joint, from its root
        Vec3 toe = kVec3Zero; ///< the target's toe joint, from its ankle; zero without one
        float sole = 0.0f;    ///< how far the sole's lower end lies below the target's ankle
    };

    /// Plans a leg by the joints of the target, which stands in rest pose with its soles on `restFloor`.
    /// Nothing where a joint but the toe is missing or without a source of its own.
    static std::optional<CFaithfulLeg> Plan(const CRetargeter& retargeter, const CPoseMatcher& matcher,
                                            const LegJoints& target, double restFloor);

    /// The joints of the source. The toe is null where its foot has no joint below.
    const LegJoints& Source() const { return m_kSource; }
    /// Takes the source's present pose as the next frame.
    void AppendSource();
    /// Takes the target's pose in a frame from the matcher's world matrices.
    void ReadTarget(const CPoseMatcher& matcher, size_t frame);

    const Frame& At(size_t frame) const { return m_kFrames[frame]; }
    const LegLengths& Lengths() const { return m_kLengths; }
    /// From hip to ankle where thigh and calf point as the source's.
    Vec3 Stretch(size_t frame) const;
    /// The bend of the source's knee; see YieldKnee.h.
    double KneeBend(size_t frame) const;
    /// Where the knee stands off the line from hip to ankle, mostly: a direction in the world, not unit.
    Vec3 Forward(const CPoseMatcher& matcher) const;

    size_t Thigh() const { return m_uiThigh; } ///< index of the target's bone
    size_t Calf() const { return m_uiCalf; }   ///< index of the target's bone
    size_t Foot() const { return m_uiFoot; }   ///< index of the target's bone
    /// The target's bones from the root down to the foot, and the toe behind it if there is one.
    const std::vector<size_t>& Path() const { return m_kPath; }

private:
    CFaithfulLeg(const CPoseMatcher& matcher, const LegJoints& source, const LegJoints& target,
                 double restFloor);

    LegJoints m_kSource;
    size_t m_uiThigh;
    size_t m_uiCalf;
    size_t m_uiFoot;
    int m_iToe; // -1 for a foot without one
    LegLengths m_kLengths;
    Vec3 m_kHeelSole;            // in the foot's space
    float m_fToeSole = 0.0f;     // below the toe joint however it is bent: some sources bend it in one frame
    Vec3 m_kForward = kVec3Zero; // sum over the frames, in the thigh's space
    std::vector<size_t> m_kPath;
    std::vector<Frame> m_kFrames;
};

} // namespace gw
