#pragma once

#include "Mat4.h"

#include <vector>

namespace gw {

class CNode;
class CPoseSampler;

/// The joints of one leg.
struct LegJoints
{
    CNode* thigh = nullptr;
    CNode* knee = nullptr;
    CNode* ankle = nullptr;
    CNode* toe = nullptr; ///< null if the foot has no joint below it
};

/// Records one leg of a skeleton, frame by frame, for checks that need all frames.
class CLegTrack
{
public:
    /// The posture of the leg in one frame. Vectors are in world space and normalized; angles are in degrees.
    struct Posture
    {
        Vec3 heading;     ///< direction of the foot, from ankle to toe
        float soleTilt;   ///< angle between the sole's normal and y
        float soleHeight; ///< y of the sole's lower end
        float kneeAngle;  ///< angle between thigh and calf; 0 for a straight leg
    };

    /// The tree may be in any pose. In its rest pose, the soles are at the height `restFloor`.
    CLegTrack(const LegJoints& joints, double restFloor);

    /// Makes a sampler pose the joints of the leg.
    void WatchJoints(CPoseSampler& sampler) const;
    bool HasToe() const { return m_kJoints.toe != nullptr; }
    /// Returns the length from thigh to knee to ankle in the current pose.
    double Length() const;
    /// Returns the height of the ankle above the sole in the rest pose; 0 for a skeleton that ends at its
    /// ankles.
    double AnkleHeight() const;
    /// Same for the toe; 0 for a skeleton without toes, or one that ends at them.
    double ToeHeight() const;
    /// Returns the unit direction of the foot in the current pose, in world space.
    Vec3 Heading() const;
    /// Defines where a foot without a toe joint points: in the current pose, in `direction` (world space).
    void SetHeading(const Vec3& direction);
    /// Adds the current pose as the next frame.
    void Append();
    /// Adds only the positions of ankle and toe as the next frame, without a posture.
    void AppendPlaces();

    /// Returns the world position of the ankle, one per frame.
    const std::vector<Vec3>& Ankles() const { return m_kAnkles; }
    /// Returns the world position of the toe, one per frame; empty for a foot without a toe joint.
    const std::vector<Vec3>& Toes() const { return m_kToes; }
    const std::vector<Posture>& Postures() const { return m_kPostures; }

private:
    float SoleHeight() const;

    LegJoints m_kJoints;
    Vec3 m_kHeelSole;             // in the ankle's space
    Vec3 m_kToeSole = kVec3Zero;  // in the toe's space
    Vec3 m_kSoleNormal;           // in the ankle's space
    Vec3 m_kHeading = kVec3UnitZ; // in the ankle's space, for a foot without a toe joint
    std::vector<Vec3> m_kAnkles;
    std::vector<Vec3> m_kToes;
    std::vector<Posture> m_kPostures;
};

/// Returns the point of the floor directly below a joint in the rest pose, in the joint's space.
Vec3 SoleUnder(const CNode& joint, double restFloor);

/// Returns the height of the floor in the rest pose: 0 if the lowest ankle or toe is at y = 0 or slightly
/// above it, otherwise the height of that joint.
double RestFloor(const std::vector<LegJoints>& legs);

} // namespace gw
