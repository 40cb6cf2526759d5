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

/// A bone that a row of a profile names and that its skeleton does not have.
struct MissingBone
{
    ESkeletonSide side = ESkeletonSide::Source;
    std::string name;
    std::string nearest; ///< the most similar name in that skeleton, or empty where none is similar; for the
                         ///< first 100
    int row = 0;         ///< in the row table
    size_t line = 0;     ///< in the file, from 1 on; 0 for rows of no file
};

/// How a profile fits two skeletons, as applying it would find.
struct CProfileFit
{
    std::string name;        ///< display name
    int rowCount = 0;        ///< one for each target bone, fixed ones included
    int foundCount = 0;      ///< rows whose bones are there
    bool drivesRoot = false; ///< a source bone that is there drives the target's root bone
    std::vector<MissingBone> missing;

    /// Whether a conversion accepts the profile.
    bool IsWhole() const { return foundCount == rowCount && drivesRoot; }
};

/// Measures how the rows of a table fit. Null roots have no bones.
CProfileFit MeasureFit(const CMapRowTable& rows, CNode* sourceRoot, CNode* targetRoot);
/// The same for the rows that loading a file would give. False, and the fit left alone, when it cannot be
/// read.
bool MeasureFit(const std::string& path, CNode* sourceRoot, CNode* targetRoot, CProfileFit& fit);

} // namespace gw
