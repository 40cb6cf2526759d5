#pragma once

#include "Alignment.h"
#include "CMadeFigure.h"

#include <functional>
#include <string>
#include <vector>

namespace gw {

/// A body that squats, turns and lifts its arms, in centimeters, expressed relative to a T-pose; and the same
/// motion relative to any other rest pose. Its joints have the target's names.
class CMadeBody
{
public:
    /// How the motion is expressed.
    struct Telling
    {
        /// Returns the rotation A of a joint: relative to it, offsets o are o · A and world rotations
        /// inverse(A) · W.
        std::function<Mat3(const std::string& joint)> turn = [](const std::string&) { return kMat3Identity; };
        Mat3 world = kMat3Identity; ///< rotates the whole motion
        bool doubled = false;       ///< positions repeat the offsets
        int tumbling = 0;           ///< frames at the end in which it turns over sideways, head first
        int frameCount = 40;
        std::vector<std::string> without; ///< missing joints, with their subtrees
    };

    explicit CMadeBody(const Telling& telling);

    BodyMotion Motion() const;
    CNode& Joint(const std::string& name) const { return m_kFigure.Bone(name); }
    bool HasJoint(const std::string& name) const { return m_kFigure.HasBone(name); }
    const std::vector<std::string>& Names() const { return m_kNames; }

private:
    void AddMesh(const std::string& name, const Telling& telling);

    std::vector<std::string> m_kNames; // depth first
    CMadeFigure m_kFigure{std::span<const MadeBone>()};
    int m_iFrames;
};

/// Returns the world matrices of all nodes of a tree at a frame, depth first.
std::vector<Mat4> WorldsAt(CNode& root, float frequency, int frame);

} // namespace gw
