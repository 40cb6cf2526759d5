#pragma once

#include "CRetargeter.h"
#include "Mat4.h"
#include "Quat.h"

#include <vector>

namespace gw {

/// Poses the target after the source's present world matrices. Which target bones share which source bone's
/// rotation, in what parts and by which decomposition does not change from frame to frame: it is worked out
/// once, and a pose is a walk over arrays. Bones stand in the order of the target tree, depth first.
class CPoseMatcher
{
public:
    /// A target bone's local pose: rotation, translation and the row lengths that it has had since the rest
    /// pose.
    struct Bone
    {
        CNode* node;
        int parent; ///< index of the parent bone, or -1
        Mat3 rotation;
        Vec3 translation;
        Vec3 scale;
        bool posed; ///< some source bone turns it
        Mat4 world; ///< while a pose is matched; fresh for the bones that were visited
    };

    /// Plans for the trees and tables of a retargeter. Both trees stand in rest pose.
    CPoseMatcher(const CRetargeter& retargeter, CNode& targetRoot);

    /// Turns the target's bones after the source's world matrices: each mapped bone takes its source's world
    /// rotation, and unmapped bones between two mapped ones take their shares of it.
    void MatchPose();
    /// Writes the bones' local poses into their nodes.
    void WriteNodes() const;
    /// Takes a node's translation back, where something outside has moved it.
    void ReadTranslation(size_t index);

    std::vector<Bone>& Bones() { return m_kBones; }
    const std::vector<Bone>& Bones() const { return m_kBones; }
    /// The bone's local matrix as it stands.
    Mat4 LocalMatrix(size_t index) const;
    /// Brings a bone's world matrix up to date with its local pose and its parent's world matrix.
    void UpdateWorld(size_t index);
    /// The index of a node's bone, or -1.
    int IndexOf(const CNode* node) const;
    /// The source nodes whose world matrices a pose reads.
    const std::vector<CNode*>& SourceNodes() const { return m_kSources; }

private:
    /// One bone of a chain that shares a source bone's rotation.
    struct Link
    {
        size_t bone;
        float fraction; ///< what of the whole rotation this bone has taken with those above it
        float curve;    ///< the same for the rotation that is shared out first, along a sine
        int type;       ///< decomposition
        bool whole;     ///< both parts are everything: the bone takes the rotation as it is
        bool turned;    ///< an offset stands on it
        Mat3 offset;
        Vec3 parentTip; ///< axis of the parent's bone mesh
    };
    /// The bones from below the nearest mapped ancestor, or a fixed one, down to a mapped bone.
    struct Chain
    {
        const Mat4* sourceWorld;
        bool free; ///< no mapped ancestor: translations follow the source too
        std::vector<Link> links;
        std::vector<size_t>
            stale; ///< ancestors that no chain visits, top down: their worlds are brought up to date
    };

    void PlanChain(const CRetargeter& retargeter, size_t bone, CNode& source, std::vector<bool>& visited);
    Link PlanLink(const CRetargeter& retargeter, size_t bone) const;
    void SpreadRotation(const Chain& chain, const Mat3& rotation, Vec3 position, const Vec3& scale);
    void PoseLink(const Chain& chain, const Link& link, const Mat3& rotation, const Vec3& scale,
                  Vec3& position);

    bool m_bPlainTurns;
    std::vector<Bone> m_kBones;
    std::vector<Chain> m_kChains;
    std::vector<CNode*> m_kSources;
};

/// What an offset of angles in degrees and a matrix does to a bone's rotation M: the result stands left of M.
Mat3 OffsetRotation(const Vec3& degrees, const Mat3& matrix);

/// Sets a node's local matrix and changes those of its children by the inverse of the change, so that the
/// children's world matrices stay. If the new matrix cannot be inverted, the children keep their matrix below
/// the old one. World matrices follow with the next update.
void SetLocalMatrixKeepChildren(CNode& node, const Mat4& local);

} // namespace gw
