// Which nodes are joints? A file does not say so. A node that a skin uses as a bone is one, but skins leave
// out joints without weights: a pelvis, the ends of fingers. A file without a skin has only clips, which also
// move cameras and props. So the search starts from sure joints and completes them: whatever lies between two
// of them, and whatever hangs below one, unless it is a mesh, camera or light. Above the topmost joints lie
// the nodes of the scene and of the "armature" object, whose effect ends up in the first joint's keys.

#include "SceneSkeleton.h"

#include "Text.h"

#include <algorithm>
#include <array>
#include <string>

namespace gw {

namespace {

using Flags = std::vector<bool>;
constexpr size_t kNone = CSceneNodes::kNone;

// Nodes that modeling programs put above a skeleton, in lower case.
constexpr std::array<std::string_view, 6> kHolders = {"armature", "rootnode", "scene",
                                                      "z_up",     "y_up",     "skeleton"};

bool IsHolder(const std::string& name)
{
    const std::string lower = LowerCase(name);
    return lower.empty() ||
           std::ranges::any_of(kHolders, [&](std::string_view holder) { return lower.starts_with(holder); });
}

bool MayBeJoint(const CSceneNodes::Node& node)
{
    return !node.isHelper && !node.isThing;
}

void MarkBones(const CSceneNodes& nodes, Flags& joints)
{
    for (unsigned m = 0; m < nodes.Scene().mNumMeshes; ++m)
    {
        const aiMesh& mesh = *nodes.Scene().mMeshes[m];
        for (unsigned b = 0; b < mesh.mNumBones; ++b)
        {
            if (const size_t node = nodes.Find(mesh.mBones[b]->mName.C_Str()); node != kNone)
                joints[node] = true;
        }
    }
}

void MarkMovedNodes(const CSceneNodes& nodes, Flags& joints)
{
    for (unsigned a = 0; a < nodes.Scene().mNumAnimations; ++a)
    {
        const aiAnimation& clip = *nodes.Scene().mAnimations[a];
        for (unsigned c = 0; c < clip.mNumChannels; ++c)
        {
            size_t node = nodes.Find(clip.mChannels[c]->mNodeName.C_Str());
            if (node != kNone && nodes[node].isHelper)
                node = nodes[node].joint;
            if (node != kNone && MayBeJoint(nodes[node]) && !IsHolder(nodes[node].name))
                joints[node] = true;
        }
    }
}

void MarkAllBelowRoot(const CSceneNodes& nodes, Flags& joints)
{
    for (size_t i = 1; i < nodes.Count(); ++i)
        joints[i] = MayBeJoint(nodes[i]) && !IsHolder(nodes[i].name);
}

bool HasAny(const Flags& flags)
{
    return std::ranges::find(flags, true) != flags.end();
}

Flags SureJoints(const CSceneNodes& nodes)
{
    Flags joints(nodes.Count());
    MarkBones(nodes, joints);
    if (!HasAny(joints))
        MarkMovedNodes(nodes, joints);
    if (!HasAny(joints) && nodes.Scene().mNumMeshes == 0)
        MarkAllBelowRoot(nodes, joints);
    return joints;
}

// Joints without a joint above them.
std::vector<size_t> TopsOf(const CSceneNodes& nodes, const Flags& joints)
{
    std::vector<size_t> tops;
    for (size_t i = 0; i < nodes.Count(); ++i)
    {
        if (!joints[i])
            continue;
        tops.push_back(i);
        i = nodes[i].end - 1;
    }
    return tops;
}

size_t CommonNode(const CSceneNodes& nodes, const std::vector<size_t>& tops)
{
    size_t common = tops.front();
    while (nodes[common].end <= tops.back() || nodes[common].isHelper)
        common = nodes[common].parent;
    return common;
}

size_t JointsBelow(const CSceneNodes& nodes, const Flags& joints, size_t top)
{
    const auto first = joints.begin() + static_cast<std::ptrdiff_t>(top);
    return static_cast<size_t>(
        std::count(first, first + static_cast<std::ptrdiff_t>(nodes[top].end - top), true));
}

// The first joint: the node that all tops share, unless that is only what holds them; then the largest
// skeleton.
size_t FirstJoint(const CSceneNodes& nodes, const Flags& joints)
{
    const std::vector<size_t> tops = TopsOf(nodes, joints);
    const size_t common = CommonNode(nodes, tops);
    if (joints[common])
        return common;
    if (MayBeJoint(nodes[common]) && !IsHolder(nodes[common].name) && nodes[common].parent != kNone)
        return common;
    return *std::ranges::max_element(tops, {}, [&](size_t top) { return JointsBelow(nodes, joints, top); });
}

} // namespace

// A node becomes a joint if its parent does: everything between two joints lies below the first one. Helpers
// are passed through, meshes and what hangs below them are left out, unless a skin uses them as bones.
SceneSkeleton FindSkeleton(const CSceneNodes& nodes)
{
    SceneSkeleton skeleton;
    const Flags sure = SureJoints(nodes);
    if (!HasAny(sure))
        return skeleton;
    const size_t first = FirstJoint(nodes, sure);
    std::vector<int> jointOf(nodes.Count(), -1); // of a node, or of the joint that a helper belongs below
    for (size_t i = first; i < nodes[first].end; ++i)
    {
        const size_t parent = nodes[i].parent;
        const int above = i == first || parent == kNone ? -1 : jointOf[parent];
        if (i != first && above < 0)
            continue;
        jointOf[i] = above;
        if (i != first && nodes[i].isHelper)
            continue;
        if (i != first && nodes[i].isThing && !sure[i])
        {
            jointOf[i] = -1;
            continue;
        }
        jointOf[i] = static_cast<int>(skeleton.nodes.size());
        skeleton.nodes.push_back(i);
        skeleton.parents.push_back(above);
    }
    return skeleton;
}

} // namespace gw
