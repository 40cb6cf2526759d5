#pragma once

#include <cstddef>
#include <string>

namespace gw {

class CSceneFile;
struct ShellOptions;

// All poses of a motion as arrays for other programs, in world space, with row vectors: a point p of a bone
// is at p · M. Each function returns false, after printing the reason, if a file cannot be written.

/// Writes one row per frame and bone: frame, name, position, and the matrix row by row. The first line names
/// the columns.
bool WritePosesAsCsv(const std::string& path, const std::string& shownPath, CSceneFile& file,
                     size_t frameCount);
/// Writes arrays of 32-bit floats that NumPy loads: frames x bones x 4 x 4 to the first path, and frames x
/// bones x 3 (positions) to the second.
bool WritePosesAsNpy(const std::string& path, const std::string& positionsPath, CSceneFile& file,
                     size_t frameCount);
/// Writes the names of the bones, one per line, in the order of the arrays.
bool WriteBoneNames(const std::string& path, const CSceneFile& file);

} // namespace gw
