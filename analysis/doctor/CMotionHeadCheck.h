#pragma once

#include "BVHOutline.h"
#include "CLineCursor.h"

#include <string_view>

namespace gw {

class CFindings;
class CTextEdits;

/// Checks the two lines between "MOTION" and the rows, as CHierarchyCheck does for the lines before.
class CMotionHeadCheck
{
public:
    CMotionHeadCheck(CLineCursor& lines, CFindings& findings, CTextEdits& edits)
        : lines_(lines), findings_(findings), edits_(edits)
    {
    }

    /// Fills the outline's motion fields and leaves the cursor before the rows. Returns false if the lines
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
