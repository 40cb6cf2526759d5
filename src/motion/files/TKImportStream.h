#pragma once

#include "CMotionFile.h"

#include <span>
#include <vector>

namespace gw {

struct ImportedMotion;

/// The extensions of the formats that the import program reads, dots included.
inline constexpr std::string_view kImportedExtensions[] = {".fbx", ".gltf", ".glb", ".vrm", ".dae"};
/// Returns whether a path has one of them.
bool IsImported(std::string_view path);

/// Files of modeling programs, read by the program gaitwright-import in a process of its own, because the
/// library behind it is large and processes strangers' files. Each joint of the skeleton becomes a node.
/// Joint rotations are relative to the rest pose: the bind pose if there is one, otherwise the pose of the
/// file's nodes. Lengths stay in file units; another up axis is turned to Y.
class TKImportStream : public CMotionFile
{
public:
    /// Fills motionRoot and `imported`. `importChoice` selects the clip.
    bool Load(const std::string& path) override;
    /// The same for what the program sent, as if it came from it now.
    bool Receive(std::span<const std::byte> message);

private:
    bool Run(const std::string& path, std::vector<std::byte>& message);
    bool Check(const ImportedMotion& motion);
    void BuildAnimatedTree(ImportedMotion& motion);
};

} // namespace gw
