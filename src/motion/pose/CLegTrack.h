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
    CNode* toe = nullptr; ///< null where the foot has no joint below
};

/// What one leg of one skeleton does, frame by frame: what can only be judged when all frames are known.
class CLegTrack
{
public:
    /// A frame's place and posture. World space; unit vectors; degrees.
    struct Posture
    {
        Vec3 heading;     ///< of the foot, from ankle to toe
        float soleTilt;   ///< between the sole's normal and y
        float soleHeight; ///< y of the sole's lower end
        float kneeAngle;  ///< between thigh and calf, 0 for a straight leg
    };

    /// The tree is posed somehow; in its rest pose the soles lie on the height `restFloor`.
    CLegTrack(const LegJoints& joints, double restFloor);

    void WatchJoints(CPoseSampler& sampler) const;
    bool HasToe() const { return m_kJoints.toe != nullptr; }
    /// Thigh to knee to ankle, as posed.
    double Length() const;
    /// The ankle above the sole in the rest pose; 0 for a skeleton that ends at its ankles.
    double AnkleHeight() const;
    /// Where the foot points, as posed.
    Vec3 Heading() const;
    /// Lets a foot without a toe joint point from now on as it would have to be pointing now.
    void SetHeading(const Vec3& direction);
    /// Takes the present pose as the next frame.
    void Append();
    /// The same without a posture.
    void AppendPlaces();

    const std::vector<Vec3>& Ankles() const { return m_kAnkles; }
    /// One a frame; none for a foot without a toe joint.
    const std::vector<Vec3>& Toes() const { return m_kToes; }
    const std::vector<Posture>& Postures() const { return m_kPostures; }

private:
    float SoleHeight() const;

    LegJoints m_kJoints;
    Vec3 m_kHeelSole;             // in the ankle's space
    Vec3 m_kToeSole = kVec3Zero;  // in the toe's
    Vec3 m_kSoleNormal;           // in the ankle's
    Vec3 m_kHeading = kVec3UnitZ; // in the ankle's, for a foot without a toe joint
    std::vector<Vec3> m_kAnkles;
    std::vector<Vec3> m_kToes;
    std::vector<Posture> m_kPostures;
};

/// What lies on the floor under a joint in the rest pose, in the joint's space.
Vec3 SoleUnder(const CNode& joint, double restFloor);

/// The height on which a skeleton stands in its rest pose: y = 0 where its feet are at or little above it,
/// else that of the lowest ankle or toe.
double RestFloor(const std::vector<LegJoints>& legs);

} // namespace gw
