#pragma once

#include "BodyStance.h"
#include "CPoseSampler.h"
#include "Mat3.h"
#include "Mat4.h"

#include <cstddef>
#include <vector>

namespace gw {

/// Poses of a body in which it can be looked at: its rest pose where it stands in it, else some frames spread
/// over its motion. Nodes that are posed on the way stand as they stood when the object goes.
class CBodyPoses
{
public:
    /// The body has both upper arms and both thighs.
    CBodyPoses(const CBodyMap& body, const BodyStance& rest);
    ~CBodyPoses();
    CBodyPoses(const CBodyPoses&) = delete;
    CBodyPoses& operator=(const CBodyPoses&) = delete;

    /// Nodes that are looked at must be watched before the first pose is taken.
    void Watch(CNode* node);
    size_t Count() const { return m_kFrames.empty() ? 1 : m_kFrames.size(); }
    /// From 0 on.
    void Take(size_t pose);

    // In the pose that was taken last.
    /// Where a watched node stands; that of its bone mesh where it has one.
    Mat4 BoneWorld(const CNode& node) const;
    Vec3 Place(const CNode& node) const { return World(node).Translation(); }
    /// The body's own axes as rows: to its left, up from the legs to the arms, forward.
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
    CPoseSampler m_kSampler;
    std::vector<double> m_kFrames; // none for the rest pose
    std::vector<Kept> m_kKept;
};

} // namespace gw
