// The library splits a joint with pivots into a chain of helper nodes. If the joint's motion is simple, one
// channel of the joint contains the whole chain's effect, and the helpers must then do nothing, although the
// file still gives them a place. Otherwise the helpers have channels themselves.

#include "CNodeTracks.h"

#include <algorithm>
#include <span>

namespace gw {

namespace {

template <class Key>
struct Neighbors
{
    const Key* before;
    const Key* after;
    double share; // of `after`
};

template <class Key>
Neighbors<Key> Around(const Key* keys, unsigned count, double ticks)
{
    const std::span<const Key> all(keys, count);
    const auto after = std::ranges::upper_bound(all, ticks, {}, &Key::mTime);
    if (after == all.begin())
        return {&all.front(), &all.front(), 0.0};
    if (after == all.end())
        return {&all.back(), &all.back(), 0.0};
    const Key& before = *(after - 1);
    return {&before, &*after, (ticks - before.mTime) / (after->mTime - before.mTime)};
}

aiVector3t<double> VectorAt(const aiVectorKey* keys, unsigned count, double ticks)
{
    const auto [before, after, share] = Around(keys, count, ticks);
    const aiVector3t<double> a(before->mValue.x, before->mValue.y, before->mValue.z);
    const aiVector3t<double> b(after->mValue.x, after->mValue.y, after->mValue.z);
    return a + (b - a) * share;
}

aiQuaterniont<double> Wide(const aiQuaternion& q)
{
    return {q.w, q.x, q.y, q.z};
}

aiQuaterniont<double> RotationAt(const aiQuatKey* keys, unsigned count, double ticks)
{
    const auto [before, after, share] = Around(keys, count, ticks);
    aiQuaterniont<double> result;
    aiQuaterniont<double>::Interpolate(result, Wide(before->mValue), Wide(after->mValue), share);
    return result.Normalize();
}

} // namespace

CNodeTracks::CNodeTracks(const CSceneNodes& nodes, const aiAnimation* animation)
    : nodes_(nodes), m_kDefaults(nodes.DefaultLocals()), m_kChannels(nodes.Count())
{
    std::vector<bool> hasMovedHelper(nodes.Count());
    for (unsigned i = 0; animation && i < animation->mNumChannels; ++i)
    {
        const size_t node = nodes.Find(animation->mChannels[i]->mNodeName.C_Str());
        if (node == CSceneNodes::kNone)
            continue;
        Channel& channel = m_kChannels[node];
        channel.keys = animation->mChannels[i];
        m_kDefaults[node].Decompose(channel.scale, channel.rotation, channel.position);
        if (nodes[node].joint != CSceneNodes::kNone)
            hasMovedHelper[nodes[node].joint] = true;
    }
    for (size_t i = 0; i < nodes.Count(); ++i)
    {
        const size_t joint = nodes[i].joint;
        if (joint != CSceneNodes::kNone && m_kChannels[joint].keys && !hasMovedHelper[joint])
            m_kDefaults[i] = SceneMatrix();
    }
}

SceneMatrix CNodeTracks::LocalAt(const Channel& channel, double ticks)
{
    const aiNodeAnim& keys = *channel.keys;
    return SceneMatrix(
        keys.mNumScalingKeys > 0 ? VectorAt(keys.mScalingKeys, keys.mNumScalingKeys, ticks) : channel.scale,
        keys.mNumRotationKeys > 0 ? RotationAt(keys.mRotationKeys, keys.mNumRotationKeys, ticks)
                                  : channel.rotation,
        keys.mNumPositionKeys > 0 ? VectorAt(keys.mPositionKeys, keys.mNumPositionKeys, ticks)
                                  : channel.position);
}

void CNodeTracks::PoseAt(double ticks, std::vector<SceneMatrix>& worlds) const
{
    worlds.resize(nodes_.Count());
    for (size_t i = 0; i < worlds.size(); ++i)
    {
        const SceneMatrix local = m_kChannels[i].keys ? LocalAt(m_kChannels[i], ticks) : m_kDefaults[i];
        const size_t parent = nodes_[i].parent;
        worlds[i] = parent == CSceneNodes::kNone ? local : worlds[parent] * local;
    }
}

} // namespace gw
