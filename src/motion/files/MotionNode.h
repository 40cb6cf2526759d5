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

/// More bones than any skeleton has. Each is three scene objects and an HTR file has each twice, which a line
/// of four bytes asks for; and attaching a child takes time by the number of its brothers.
inline constexpr size_t kBoneLimit = 16384;

/// Longer names of bones are refused.
inline constexpr size_t kNameLimit = 255;
/// Whether a bone may have a name: short enough, and without the zero byte that would end it early in the
/// tree and in every file that is written of it.
bool MayBeName(std::string_view name);

/// The number of key times, 16 MB of them, that a file of any size may have.
inline constexpr size_t kKeyTimesOfAnyFile = size_t{1} << 22;
/// Whether that many key times on that many nodes are in proportion to the file: every node gets a time for
/// each frame that the header counts, whatever rows follow. Up to `anySize` times fit into any file.
bool KeyTimesFit(int64_t frameCount, size_t nodeCount, size_t fileBytes, size_t anySize = kKeyTimesOfAnyFile);

/// Gives a node a new track without keys: times 0, 1, ... in frames, the frame time in seconds as frequency,
/// and a rest matrix.
CKeyframeControl& AttachTrack(CNode& node, int frameCount, float frequency, const Mat4& restMatrix);

/// Gives a node a bone mesh of its name and of a length: a ball where the bone has more than one child, else
/// a tapered bone. A length of 0 or below leaves the mesh empty.
CBoneMesh& AttachBone(CNode& node, const std::string& name, size_t childCount, float length);

/// A new child of a node.
CNode& AttachNode(CNode& parent);

/// Makes a tree of nodes after a tree of records, root first: fill(record, node) for each that MakesNode().
/// Files nest thousands deep, so it takes no stack for a level.
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
