#pragma once

#include "CHTRRowText.h"
#include "Mat4.h"

#include <cstdint>

namespace gw {

class CMotionFile;

/// The base pose of a segment: its translation, and its rotation as "ZYX" angles in degrees.
struct HTRBase
{
    Vec3 translation = kVec3Zero;
    Vec3 degrees = kVec3Zero;
};

/// How angles are written at a quarter turn about Y, where the angles about X and Z are not unique.
enum class EQuarterTurns : uint8_t
{
    Flipped, ///< same formula as for all other poses; reads back as the opposite quarter turn
    ReadBack ///< angles that read back as the same pose, within 0.001 degrees
};

/// Returns the row for a local matrix. Only the root's row includes its translation.
HTRRow RowOf(const Mat4& local, bool isRoot, const HTRBase& base, EQuarterTurns quarterTurns);

/// Changes the motion of a result to what its file contains: the rest pose of each bone is the base pose,
/// bones keep their base offsets, and keys near a quarter turn about Y become what a reader gets from their
/// text. All other rotations are unchanged, because the six decimals of the text are finer than a key's 32
/// bits. Call it after the result is saved.
void TakeWrittenPoses(const CMotionFile& result);

} // namespace gw
