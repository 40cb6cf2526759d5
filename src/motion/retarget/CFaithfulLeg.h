#pragma once

#include "CLegTrack.h"
#include "CPoseMatcher.h"
#include "FootPitch.h"
#include "YieldKnee.h"

#include <optional>
#include <vector>

namespace gw {

/// One leg of the target that follows a leg of the source: its bones, their lengths, and the motion of source
/// and target, frame by frame.
class CFaithfulLeg
{
public:
    /// One frame of the leg. Directions are in world space, lengths in the target's units.
    struct Frame
    {
        Vec3 thigh;                 ///< unit direction of the source from hip to knee
        Vec3 shin;                  ///< unit direction of the source from knee to ankle
        Vec3 hip = kVec3Zero;       ///< the target's hip joint, relative to its root
        Vec3 toe = kVec3Zero;       ///< the target's toe joint, relative to its ankle; zero without one
        Vec3 heelEnd = kVec3Zero;   ///< the heel end of the target's sole, relative to its ankle
        float heel = 0.0f;          ///< how far that is below the ankle
        float sole = 0.0f;          ///< how far the sole's lower end is below the ankle
        float toeSole = 0.0f;       ///< how far the sole's toe end is below the target's toe joint
        Vec3 knee = kVec3Zero;      ///< the knee of Stretch, relative to the line between hip and ankle
        Mat3 pitch = kMat3Identity; ///< rotation of the target's foot that makes up for its length
    };

    /// Plans a leg from the joints of the target, which must be in rest pose with its soles at the height
    /// `restFloor`. Returns nothing if a joint other than the toe is missing, has no source, or shares its
    /// source with another joint of the leg.
    static std::optional<CFaithfulLeg> Plan(const CRetargeter& retargeter, const CPoseMatcher& matcher,
                                            const LegJoints& target, double restFloor);

    /// Returns the joints of the source. The toe is null if the foot has no joint below it.
    const LegJoints& Source() const { return m_kSource; }
    /// Adds the source's current pose as the next frame.
    void AppendSource();
    /// Reads the target's pose of a frame from the matcher's world matrices. The frame must have been
    /// appended. `moved` is how far the source's toe is, relative to its ankle, from where it is in a foot
    /// that stands flat, in the target's scale; NaN for a foot without a toe.
    void ReadTarget(const CPoseMatcher& matcher, size_t frame, const ToePlace& moved);

    /// Steadies the direction in which the knee is bent, which a nearly straight leg changes within a few
    /// frames. All frames must have been read.
    void SteadyKnee(double secondsPerFrame);
    /// Rotates the target's foot in a frame that has been read.
    void TurnFoot(size_t frame, const Mat3& turn);

    const Frame& At(size_t frame) const { return m_kFrames[frame]; }
    /// Returns whether the target's foot has a toe.
    bool HasToe() const { return m_iToe >= 0; }
    const LegLengths& Lengths() const { return m_kLengths; }
    /// Returns the height of the ankle of a foot that stands flat.
    float AnkleHeight() const { return static_cast<float>(Vec3Length(m_kHeelSole)); }
    /// Returns how far the toe of a foot that stands flat is below its ankle.
    double FlatDrop() const { return -m_kFlatToe.height; }
    /// Returns how far the sole's toe end is below the target's ankle; 0 without a toe.
    float ToeSole(size_t frame) const;
    /// Returns the vector from hip to ankle if thigh and calf point in the source's directions.
    Vec3 Stretch(size_t frame) const;
    /// Returns the bend of the source's knee, 0 to 1; see YieldKnee.h.
    double KneeBend(size_t frame) const;
    /// Returns the usual direction from the line between hip and ankle to the knee, for the matcher's current
    /// pose: in world space, not normalized.
    Vec3 Forward(const CPoseMatcher& matcher) const;

    size_t Thigh() const { return m_uiThigh; } ///< index of the target's bone
    size_t Calf() const { return m_uiCalf; }   ///< index of the target's bone
    size_t Foot() const { return m_uiFoot; }   ///< index of the target's bone
    /// Returns the indices of the target's bones from the root down to the foot, and to the toe if there is
    /// one.
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
    ToePlace m_kFlatToe{};       // in the rest pose
    float m_fToeSole = 0.0f;     // below the toe joint in the rest pose
    Vec3 m_kForward = kVec3Zero; // summed over the frames, in the thigh's space
    std::vector<size_t> m_kPath;
    std::vector<Frame> m_kFrames;
};

} // namespace gw
