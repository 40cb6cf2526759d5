#pragma once

#include "Numbers.h"
#include "Vec3.h"

#include <cstddef>

namespace gw {

class CLineWriter;

/// One row of a segment in a file: a node's pose relative to its base pose.
struct HTRRow
{
    Vec3 translation = kVec3Zero;
    Vec3 degrees = kVec3Zero;
    float scale = 1.0f;
};

/// Writes the rows of one segment. Columns equal to the previous row's, usually four of the seven, are copied
/// instead of formatted again.
class CHTRRowText
{
public:
    /// Writes "number Tx Ty Tz Rx Ry Rz SF" as a line. A value that is not finite becomes 0.
    void Write(CLineWriter& out, int number, const HTRRow& row);
    /// Writes the last row again with another number.
    void Repeat(CLineWriter& out, int number) const;

private:
    static constexpr size_t kColumns = 7;

    char* WriteTranslation(const Vec3& translation);
    char* WriteScale(char* out, float scale);

    HTRRow m_kLast;
    bool m_bHasLast = false;
    // The last row from the blank after its number to its line end, and the lengths of its first and last
    // parts.
    char m_acText[kColumns * (1 + kFixed6Bytes) + 2];
    char m_acScale[1 + kFixed6Bytes + 2];
    size_t m_uiText = 0;
    size_t m_uiTranslation = 0;
    size_t m_uiScale = 0;
};

} // namespace gw
