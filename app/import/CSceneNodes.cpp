#include "CSceneNodes.h"

#include <algorithm>
#include <utility>

namespace gw {

namespace {

constexpr std::string_view kHelperMark = "_$AssimpFbx$_";

} // namespace

CSceneNodes::CSceneNodes(const aiScene& scene) : scene_(scene)
{
    // Not recursive, because files nest thousands of levels deep.
    std::vector<std::pair<const aiNode*, size_t>> waiting{
        {scene.mRootNode, kNone}
    };
    while (!waiting.empty())
    {
        const auto [node, parent] = waiting.back();
        waiting.pop_back();
        const size_t index = m_kNodes.size();
        Add(*node, parent);
        for (unsigned i = node->mNumChildren; i-- > 0;)
            waiting.emplace_back(node->mChildren[i], index);
    }
    MarkEnds();
    ListNames();
    MarkThings();
    ListNames(); // again, now that it is known what is a thing
    MarkHelpers();
}

void CSceneNodes::Add(const aiNode& node, size_t parent)
{
    m_kNodes.push_back({.node = &node, .parent = parent, .name = node.mName.C_Str()});
    m_kNodes.back().isThing = node.mNumMeshes > 0;
}

void CSceneNodes::ListNames()
{
    m_kIndexOfName.clear();
    for (const bool areThings : {false, true})
    {
        for (size_t i = 0; i < m_kNodes.size(); ++i)
        {
            if (m_kNodes[i].isThing == areThings)
                m_kIndexOfName.emplace(m_kNodes[i].name, i);
        }
    }
}

void CSceneNodes::MarkEnds()
{
    for (size_t i = m_kNodes.size(); i-- > 0;)
    {
        m_kNodes[i].end = std::max(m_kNodes[i].end, i + 1);
        if (m_kNodes[i].parent != kNone)
            m_kNodes[m_kNodes[i].parent].end = std::max(m_kNodes[m_kNodes[i].parent].end, m_kNodes[i].end);
    }
}

void CSceneNodes::MarkHelpers()
{
    for (Node& node : m_kNodes)
    {
        const size_t mark = node.name.find(kHelperMark);
        node.isHelper = mark != node.name.npos;
        if (node.isHelper)
            node.joint = Find(std::string_view(node.name).substr(0, mark));
    }
}

void CSceneNodes::MarkThings()
{
    const auto mark = [&](const aiString& name) {
        if (const size_t node = Find(name.C_Str()); node != kNone)
            m_kNodes[node].isThing = true;
    };
    for (unsigned i = 0; i < scene_.mNumCameras; ++i)
        mark(scene_.mCameras[i]->mName);
    for (unsigned i = 0; i < scene_.mNumLights; ++i)
        mark(scene_.mLights[i]->mName);
}

size_t CSceneNodes::Find(std::string_view name) const
{
    const auto found = m_kIndexOfName.find(name);
    return found == m_kIndexOfName.end() ? kNone : found->second;
}

bool CSceneNodes::IsShared(std::string_view name) const
{
    const auto hasName = [&](const Node& node) { return !node.isThing && node.name == name; };
    return std::ranges::count_if(m_kNodes, hasName) > 1;
}

std::vector<SceneMatrix> CSceneNodes::WorldOf(const std::vector<SceneMatrix>& locals) const
{
    std::vector<SceneMatrix> worlds(locals);
    for (size_t i = 0; i < worlds.size(); ++i)
    {
        if (m_kNodes[i].parent != kNone)
            worlds[i] = worlds[m_kNodes[i].parent] * locals[i];
    }
    return worlds;
}

std::vector<SceneMatrix> CSceneNodes::DefaultLocals() const
{
    std::vector<SceneMatrix> locals;
    for (const Node& node : m_kNodes)
        locals.emplace_back(node.node->mTransformation);
    return locals;
}

} // namespace gw
