#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

namespace gw {

class CMapRowTable;
class CNode;

enum class ESkeletonSide : uint8_t
{
    Source,
    Target,
};

/// A bone that a profile names but the skeleton lacks.
struct MissingBone
{
    ESkeletonSide side = ESkeletonSide::Source;
    std::string name;
    std::string nearest; ///< the most similar name in that skeleton, or empty; for the first 100 only
    int row = 0;         ///< index in the row table
    size_t line = 0;     ///< in the file, starting at 1; 0 for rows without a file
};

/// How a profile fits two skeletons, without applying it.
struct CProfileFit
{
    std::string name;        ///< display name
    int rowCount = 0;        ///< one per target bone, fixed ones included
    int foundCount = 0;      ///< rows whose bones exist
    bool drivesRoot = false; ///< an existing source bone drives the target's root bone
    std::vector<MissingBone> missing;

    /// Returns whether a conversion accepts the profile.
    bool IsWhole() const { return foundCount == rowCount && drivesRoot; }
};

/// Returns how the rows of a table fit. A null root has no bones.
CProfileFit MeasureFit(const CMapRowTable& rows, CNode* sourceRoot, CNode* targetRoot);
/// Same for the rows of a file. Returns false, leaving `fit` unchanged, if it cannot be read.
bool MeasureFit(const std::string& path, CNode* sourceRoot, CNode* targetRoot, CProfileFit& fit);

} // namespace gw
