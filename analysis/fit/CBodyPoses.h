#pragma once

#include "BodyStance.h"
#include "CPoseSampler.h"
#include "CRestWorlds.h"
#include "Mat3.h"
#include "Mat4.h"

#include <cstddef>
#include <vector>

namespace gw {

/// Poses in which a body can be judged: its rest pose if that is a standing pose, otherwise some frames
/// spread over its motion. Nodes posed here are restored when the object is destroyed.
class CBodyPoses
{
public:
    /// `body` must have both upper arms and both thighs.
    CBodyPoses(const CBodyMap& body, const BodyStance& rest, CRestWorlds& worlds);
    ~CBodyPoses();
    CBodyPoses(const CBodyPoses&) = delete;
    CBodyPoses& operator=(const CBodyPoses&) = delete;

    /// Watches a node. Call it for all nodes before the first pose.
    void Watch(CNode* node);
    /// Returns the number of poses, at least 1.
    size_t Count() const { return m_kFrames.empty() ? 1 : m_kFrames.size(); }
    /// Poses the tree; the first pose is 0.
    void Take(size_t pose);

    // In the current pose.
    /// Returns the world matrix of a watched node, or of its bone mesh if it has one.
    Mat4 BoneWorld(const CNode& node) const;
    /// Returns the world position of a watched node.
    Vec3 Place(const CNode& node) const { return World(node).Translation(); }
    /// Returns the body's own axes as rows: left, up from the legs to the arms, forward.
    Mat3 Axes() const;

private:
    struct Kept
    {
        CNode* node;
        Mat4 local;
        Mat4 world;
    };

    Mat4 World(const CNode& node) const;
    void PlanFrames();

    const CBodyMap& body_;
    CRestWorlds& worlds_;
    CPoseSampler m_kSampler;
    std::vector<double> m_kFrames; // empty for the rest pose
    std::vector<Kept> m_kKept;
};

} // namespace gw
