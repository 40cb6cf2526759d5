#pragma once

#include "CRetargeter.h"
#include "Mat4.h"
#include "Quat.h"

#include <vector>

namespace gw {

/// Poses the target like the source's current world matrices. Which target bones share a source bone's
/// rotation, in which parts and by which decomposition, is the same for all frames. It is planned once, and a
/// pose is a loop over arrays. Bones are in the order of the target tree, depth first.
class CPoseMatcher
{
public:
    /// A target bone's local pose: rotation, translation, and the row lengths of the rest pose.
    struct Bone
    {
        CNode* node;
        int parent; ///< index of the parent bone, or -1
        Mat3 rotation;
        Vec3 translation;
        Vec3 scale;
        bool posed; ///< driven by a source bone
        Mat4 world; ///< valid while a pose is matched, for the bones visited so far
    };

    /// Plans for the trees and tables of a retargeter. Both trees must be in rest pose.
    CPoseMatcher(const CRetargeter& retargeter, CNode& targetRoot);

    /// Poses the target's bones from the source's world matrices: each mapped bone gets its source's world
    /// rotation, and unmapped bones between two mapped ones get their shares of it.
    void MatchPose();
    /// Writes the bones' local poses to their nodes.
    void WriteNodes() const;
    /// Reads a bone's translation from its node, after other code has moved the node.
    void ReadTranslation(size_t index);

    std::vector<Bone>& Bones() { return m_kBones; }
    const std::vector<Bone>& Bones() const { return m_kBones; }
    /// The bone's current local matrix.
    Mat4 LocalMatrix(size_t index) const;
    /// Recomputes a bone's world matrix from its local pose and its parent's world matrix.
    void UpdateWorld(size_t index);
    /// The index of a node's bone, or -1.
    int IndexOf(const CNode* node) const;
    /// The source nodes whose world matrices MatchPose reads.
    const std::vector<CNode*>& SourceNodes() const { return m_kSources; }

private:
    /// One bone of a chain that shares a source bone's rotation.
    struct Link
    {
        size_t bone;
        float fraction; ///< cumulative share of the whole rotation, this bone included
        float curve;    ///< cumulative share of the first rotation, along a sine
        int type;       ///< decomposition
        bool whole;     ///< both shares are 1: the bone takes the rotation unchanged
        bool turned;    ///< the bone has an offset
        Mat3 offset;
        Vec3 parentTip; ///< bone axis of the parent's mesh
    };
    /// The bones from below the nearest mapped ancestor, or below a fixed bone, down to a mapped bone.
    struct Chain
    {
        const Mat4* sourceWorld;
        bool free; ///< no mapped ancestor: translations follow the source too
        std::vector<Link> links;
        std::vector<size_t>
            stale; ///< ancestors in no chain, top down; their world matrices are updated first
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

/// Rotation of an offset, given as angles in degrees and a matrix. It is multiplied to the left of a bone's
/// rotation.
Mat3 OffsetRotation(const Vec3& degrees, const Mat3& matrix);

/// Sets a node's local matrix and compensates in its children, so that their world matrices stay the same. If
/// the new matrix is singular, the children are transformed by the old one only. World matrices change with
/// the next update.
void SetLocalMatrixKeepChildren(CNode& node, const Mat4& local);

} // namespace gw
