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

/// The angles of a pose at a quarter turn about Y, where those about X and Z run into each other.
enum class EQuarterTurns : uint8_t
{
    Flipped, ///< by the rule for all poses, which a reader takes for the opposite turn
    ReadBack ///< angles that a reader turns into the pose again, to 0.001 degrees
};

/// The row of a local matrix. Only the root carries its translation.
HTRRow RowOf(const Mat4& local, bool isRoot, const HTRBase& base, EQuarterTurns quarterTurns);

/// Changes the motion of a result to what its file has of it: bones rest as the base pose and keep its
/// offsets, and keys near a quarter turn about Y become what a reader makes of their text. All others keep
/// their turns, as the text's six decimals are finer than a key's 32 bits. To be called when the result is
/// saved.
void TakeWrittenPoses(const CMotionFile& result);

} // namespace gw
