#pragma once

#include "CByteSink.h"
#include "Quat.h"
#include "Vec3.h"

#include <cstddef>
#include <cstdint>
#include <span>
#include <string>
#include <vector>

namespace gw {

/// How an import ended. The values are part of the message.
enum class EImport : uint32_t
{
    Done,
    Refused,    ///< the library cannot read the file; `words` has its reason
    NoSkeleton, ///< no joints: only meshes, cameras or lights
    NoClip,     ///< no clip has the requested name; `words` repeats it
    TooLarge,   ///< more joints or keys than any motion needs
};

/// A joint with its keys, one per frame. Rotations are relative to the rest pose, in which every joint's axes
/// are parallel to the world's, as in a BVH file.
struct ImportedJoint
{
    std::string name;
    int32_t parent = -1;     ///< index of an earlier joint; -1 for the first
    Vec3 offset = kVec3Zero; ///< from the parent at rest, in file units; the first joint's is its position
    std::vector<Vec3> positions; ///< relative to the parent
    std::vector<Quat> rotations;
};

/// A motion from a file that another program reads, and how the two programs exchange it.
struct ImportedMotion
{
    EImport outcome = EImport::Done;
    std::string words;
    std::vector<std::string> clips; ///< the names of all clips in the file
    std::string clip;               ///< the one that was read; empty if the file has none
    double rate = 0.0;              ///< frames per second
    bool isRateOfFile = false;      ///< the rate was found in the file
    double unitMeters = 0.0;        ///< length of a unit in meters; 0 if the file does not contain it
    bool wasTurnedUp = false;       ///< the file's up axis was not Y
    uint32_t frameCount = 0;
    std::vector<ImportedJoint> joints; ///< parents first
};

/// Sends the motion to a sink as bytes of this machine. Returns false if the sink refuses them.
bool WriteImported(const ImportedMotion& motion, const CByteSink& sink);
/// Reads such bytes. Returns false if they are incomplete, or describe no tree.
bool ReadImported(std::span<const std::byte> bytes, ImportedMotion& motion);

} // namespace gw
