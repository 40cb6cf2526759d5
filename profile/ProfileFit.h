#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

namespace gw {

class CNode;

enum class ESkeletonSide : uint8_t
{
    Source,
    Target,
};

/// A bone that a row of a profile names and that its skeleton does not have.
struct CMissingBone
{
    ESkeletonSide side = ESkeletonSide::Source;
    std::string name;
    std::string nearest; ///< the most similar name in that skeleton, or empty where none is similar
    size_t line = 0;     ///< in the profile's file, from 1 on; 0 for a row that every profile gets
};

/// How a profile fits two skeletons, as applying it would find.
struct CProfileFit
{
    std::string name;        ///< display name
    int rowCount = 0;        ///< one for each target bone, fixed ones included
    int foundCount = 0;      ///< rows whose bones are there
    bool drivesRoot = false; ///< a source bone that is there drives the target's root bone
    std::vector<CMissingBone> missing;

    /// Whether a conversion accepts the profile.
    bool IsWhole() const { return foundCount == rowCount && drivesRoot; }
};

/// Measures how the profile in a file fits. False when the file cannot be read. Null roots have no bones.
bool MeasureFit(const std::string& path, CNode* sourceRoot, CNode* targetRoot, CProfileFit& fit);

} // namespace gw
