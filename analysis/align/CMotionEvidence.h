#pragma once

#include "CBodyMap.h"
#include "CHingeMeter.h"
#include "CSoleMeter.h"

#include <array>
#include <optional>
#include <span>
#include <vector>

namespace gw {

struct BodyMotion;

/// A joint of the trunk whose bone has no length of its own, and the next one above that stands apart.
struct LooseWay
{
    CNode* from;
    CNode* to;
};

/// What a whole motion tells of the body's bones: about which axes knees and elbows bend, how the soles lie,
/// and in which frame the body stands most like a figure in a reference pose.
class CMotionEvidence
{
public:
    /// Looks at the motion, at thirty frames a second or all there are. `worldTurn` turns it so that Y is up.
    CMotionEvidence(const BodyMotion& motion, const Mat3& worldTurn, std::span<const LooseWay> ways);

    /// The axis of a knee or an elbow in the space of one of its bones: cross(upper way, lower way).
    std::optional<Vec3> HingeAxis(const CNode& bone) const;
    /// The sole's normal in the foot's space.
    const std::optional<Vec3>& SoleNormal(EBodySide side) const
    {
        return m_kSoles[static_cast<size_t>(side)];
    }
    /// Where a loose way leads on the whole, in the space of its joint; none for other joints.
    std::optional<Vec3> MeanWay(const CNode& from) const;
    /// The frame that is most like a reference pose; -1 in a motion without frames.
    int ReferenceFrame() const { return m_iReferenceFrame; }

private:
    struct Hinge
    {
        const CNode* upper;
        const CNode* lower;
        const CNode* end;
        CHingeMeter inUpper;
        CHingeMeter inLower;
    };

    struct Way
    {
        LooseWay joints;
        Vec3 sum; // of unit vectors in the space of the lower joint
    };

    void Walk(const BodyMotion& motion, const Mat3& worldTurn);
    void JudgeFrame(const CBodyMap& body, const Vec3& up, int frame);

    std::array<Hinge, 4> m_kHinges;
    std::vector<Way> m_kWays;
    std::array<std::optional<Vec3>, 2> m_kSoles;
    int m_iReferenceFrame = -1;
    double m_fReferenceError = 0.0;
};

} // namespace gw
