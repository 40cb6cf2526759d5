#pragma once

#include "Alignment.h"
#include "CKeyframeControl.h"
#include "CMadeFigure.h"

#include <functional>
#include <initializer_list>
#include <string>
#include <vector>

namespace gw {

/// A body that squats, turns and lifts its arms, in centimeters, expressed relative to a T-pose; and the same
/// motion relative to any other rest pose. Its joints have the target's names.
class CMadeBody
{
public:
    /// Returns the rotation A of a joint: relative to it, offsets o are o · A and world rotations
    /// inverse(A) · W.
    using Turn = std::function<Mat3(const std::string& joint)>;
    /// How the motion is expressed.
    struct Telling
    {
        Turn turn = [](const std::string&) { return kMat3Identity; };
        Mat3 world = kMat3Identity; ///< rotates the whole motion
        bool doubled = false;       ///< positions repeat the offsets
        int tumbling = 0;           ///< frames at the end in which it turns over sideways, head first
        int frameCount = 40;
        std::vector<std::string> without{}; ///< missing joints, with their subtrees
    };

    explicit CMadeBody(const Telling& telling);

    BodyMotion Motion() const;
    CNode& Joint(const std::string& name) const { return m_kFigure.Bone(name); }
    CKeyframeControl& Track(const std::string& name) const;
    bool HasJoint(const std::string& name) const { return m_kFigure.HasBone(name); }
    const std::vector<std::string>& Names() const { return m_kNames; }

private:
    std::vector<std::string> m_kNames; // depth first
    CMadeFigure m_kFigure{std::span<const MadeBone>()};
    int m_iFrames;
};

/// Lowers the arms from the T-pose, with the hands.
CMadeBody::Turn ArmsDown(double degrees);
/// Returns whether a joint is one of these parts of the left or right side.
bool IsOneOf(const std::string& joint, std::initializer_list<const char*> parts);

/// Returns the world matrices of all nodes of a tree at a frame, depth first.
std::vector<Mat4> WorldsAt(CNode& root, float frequency, int frame);

} // namespace gw
