#pragma once

#include "CNode.h"

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace gw {

class CBoneMesh;
class CKeyframeControl;

/// More bones than any skeleton has. Each bone becomes three scene objects, twice in an HTR file, for a line
/// of only four bytes; and attaching a child takes time proportional to the number of its siblings.
inline constexpr size_t kBoneLimit = 16384;

/// Longer names of bones are refused.
inline constexpr size_t kNameLimit = 255;
/// Returns whether a bone can have this name: short enough, and without a zero byte, which would truncate it
/// in the tree and in every file written from it.
bool MayBeName(std::string_view name);

/// The number of key times (16 MB) that a file of any size may have.
inline constexpr size_t kKeyTimesOfAnyFile = size_t{1} << 22;
/// Returns whether that many key times on that many nodes are plausible for the file size: every node gets a
/// time for each frame that the header counts, whatever rows follow. Up to `anySize` times are always
/// allowed.
bool KeyTimesFit(int64_t frameCount, size_t nodeCount, size_t fileBytes, size_t anySize = kKeyTimesOfAnyFile);

/// Gives a node a new track without keys: times 0, 1, ... in frames, the frame time in seconds as frequency,
/// and a rest matrix.
CKeyframeControl& AttachTrack(CNode& node, int frameCount, float frequency, const Mat4& restMatrix);

/// How bone meshes are made. A bone has its length and direction either way.
enum class EBoneMeshes : uint8_t
{
    Drawn,
    DrawnInMotion, ///< those of the rest tree without points, for a target that is not shown
    Empty,         ///< without points, for a source that is not shown
};

/// Gives a node a bone mesh with a name and length: a ball if the bone has more than one child, otherwise a
/// tapered bone. A length of 0 or below leaves the mesh empty.
CBoneMesh& AttachBone(CNode& node, const std::string& name, size_t childCount, float length,
                      EBoneMeshes meshes = EBoneMeshes::Drawn);

/// Adds a new child to a node.
CNode& AttachNode(CNode& parent);

/// Builds a tree of nodes from a tree of records, root first, calling fill(record, node) for each record that
/// MakesNode(). Not recursive, because files nest thousands of levels deep.
template <class Record, class Fill>
void BuildNodes(Record& root, CNode& rootNode, Fill fill)
{
    std::vector<std::pair<Record*, CNode*>> waiting{
        {&root, &rootNode}
    };
    while (!waiting.empty())
    {
        const auto [record, node] = waiting.back();
        waiting.pop_back();
        fill(*record, *node);
        for (const auto& child : record->children)
        {
            if (child->MakesNode())
                waiting.emplace_back(&*child, &AttachNode(*node));
        }
    }
}

} // namespace gw
