#pragma once

#include <assimp/scene.h>

#include <cstddef>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

namespace gw {

/// A matrix of the library, for column vectors, in double precision.
using SceneMatrix = aiMatrix4x4t<double>;

/// The nodes of an imported scene as a list: each node is followed by everything below it.
class CSceneNodes
{
public:
    static constexpr size_t kNone = static_cast<size_t>(-1);

    struct Node
    {
        const aiNode* node = nullptr;
        size_t parent = kNone;
        size_t end = 0; ///< index after the last node below this one
        std::string name;
        bool isHelper = false; ///< one of the nodes that the library adds for a joint's pivots
        size_t joint = kNone;  ///< of a helper: the node that it belongs to
        bool isThing = false;  ///< a mesh, camera or light
    };

    explicit CSceneNodes(const aiScene& scene);

    const aiScene& Scene() const { return scene_; }
    size_t Count() const { return m_kNodes.size(); }
    const Node& operator[](size_t index) const { return m_kNodes[index]; }
    /// Returns the first node with a name, or kNone. Meshes, cameras and lights come last: a mesh is often
    /// called like the joint that moves it.
    size_t Find(std::string_view name) const;
    /// Returns whether several nodes other than things have a name.
    bool IsShared(std::string_view name) const;
    /// Returns the world matrices of all nodes from their local ones.
    std::vector<SceneMatrix> WorldOf(const std::vector<SceneMatrix>& locals) const;
    /// Returns the local matrices that the file gives its nodes.
    std::vector<SceneMatrix> DefaultLocals() const;

private:
    void Add(const aiNode& node, size_t parent);
    void MarkEnds();
    void MarkHelpers();
    void MarkThings();
    void ListNames();

    const aiScene& scene_;
    std::vector<Node> m_kNodes;
    std::unordered_map<std::string_view, size_t> m_kIndexOfName;
};

} // namespace gw
