#pragma once

#include "CFailureRecord.h"

#include <cstddef>
#include <string_view>

namespace gw {

class CTextLines;
struct TKBVHFile;
struct TKBVHJoint;

/// Reads the hierarchy of a BVH file, from after the line "HIERARCHY" to the line "MOTION". The first word of
/// a line determines its meaning; unknown lines are skipped.
class CBVHHierarchyReader
{
public:
    CBVHHierarchyReader(CTextLines& lines, TKBVHFile& file, CFailureRecord& record)
        : lines_(lines), file_(file), record_(record)
    {
    }

    /// Replaces the file's records and leaves the cursor before "MOTION". Returns false, with the reason in
    /// the record, if that line is missing or a block is invalid.
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
    size_t m_uiSwallowedMotion = 0; // line of a "MOTION" inside an unclosed block
};

} // namespace gw
