#pragma once

#include "BVHOutline.h"
#include "CLineCursor.h"

#include <string_view>

namespace gw {

class CFindings;
class CTextEdits;

/// Reads the two lines between "MOTION" and the rows, as CHierarchyCheck reads what comes before.
class CMotionHeadCheck
{
public:
    CMotionHeadCheck(CLineCursor& lines, CFindings& findings, CTextEdits& edits)
        : lines_(lines), findings_(findings), edits_(edits)
    {
    }

    /// Fills the outline's head of the motion and leaves the cursor before the rows. False where the lines
    /// cannot be understood.
    bool Read(BVHOutline& outline);

private:
    bool NextValue(std::string_view keyword, std::string_view& value);
    bool SkipEmptyLines();
    bool ReadFrameCount(BVHOutline& outline);
    bool ReadFrameTime(BVHOutline& outline);

    CLineCursor& lines_;
    CFindings& findings_;
    CTextEdits& edits_;
};

} // namespace gw
