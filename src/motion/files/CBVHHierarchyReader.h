#pragma once

#include "CFailure.h"

#include <cstddef>
#include <string_view>

namespace gw {

class CTextLines;
struct TKBVHFile;
struct TKBVHJoint;

/// Reads the hierarchy of a BVH file, from behind the line "HIERARCHY" up to the line "MOTION". The first
/// word of a line decides what it is; lines that mean nothing are skipped.
class CBVHHierarchyReader
{
public:
    CBVHHierarchyReader(CTextLines& lines, TKBVHFile& file, CFailureRecord& record)
        : lines_(lines), file_(file), record_(record)
    {
    }

    /// Replaces the file's records. Leaves the cursor before "MOTION". False, with the reason in the record,
    /// where that never comes or a block is no good.
    bool Read();

private:
    bool ReadTopJoint(std::string_view rest);
    bool ReadJoint(TKBVHJoint& joint, std::string_view rest, size_t depth);
    bool ReadBody(TKBVHJoint& joint, size_t depth);
    bool ReadBodyLine(TKBVHJoint& joint, std::string_view keyword, std::string_view rest, size_t depth);
    bool ReadName(TKBVHJoint& joint, std::string_view rest);
    bool ReadOffset(TKBVHJoint& joint, std::string_view rest);
    bool ReadChannels(TKBVHJoint& joint, std::string_view rest);
    bool Fail(EFailure reason, std::string_view name);

    CTextLines& lines_;
    TKBVHFile& file_;
    CFailureRecord& record_;
    size_t m_uiSwallowedMotion = 0; // a line "MOTION" inside a block that is not closed
};

} // namespace gw
