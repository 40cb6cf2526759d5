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

/// A trunk joint whose bone has no length, and the next joint above that is apart from it.
struct LooseWay
{
    CNode* from;
    CNode* to;
};

/// What a whole motion shows about the body's bones: the axes of knees and elbows, the orientation of the
/// soles, and the frame that is closest to a reference pose.
class CMotionEvidence
{
public:
    /// Examines the motion at thirty frames per second, or all frames if there are fewer. `worldTurn` rotates
    /// it so that Y is up. `seeksFrame` says whether to find the reference frame, too.
    CMotionEvidence(const BodyMotion& motion, const Mat3& worldTurn, std::span<const LooseWay> ways,
                    bool seeksFrame);

    /// Returns the axis of a knee or an elbow in the space of one of its bones: cross(upper way, lower way).
    std::optional<Vec3> HingeAxis(const CNode& bone) const;
    /// Returns the sole's normal in the foot's space.
    const std::optional<Vec3>& SoleNormal(EBodySide side) const
    {
        return m_kSoles[static_cast<size_t>(side)];
    }
    /// Returns the mean direction of a loose way in the space of its joint; nothing for other joints.
    std::optional<Vec3> MeanWay(const CNode& from) const;
    /// Returns the frame closest to a reference pose; -1 without `seeksFrame` or in a motion without frames.
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

    void Walk(const BodyMotion& motion, const Mat3& worldTurn, bool seeksFrame);
    void AddFrame();
    void JudgeFrame(const CBodyMap& body, const Vec3& up, int frame);

    std::array<Hinge, 4> m_kHinges;
    std::vector<Way> m_kWays;
    std::array<std::optional<Vec3>, 2> m_kSoles;
    int m_iReferenceFrame = -1;
    double m_fReferenceError = 0.0;
};

} // namespace gw
