#pragma once

#include "CFailure.h"

#include <cstddef>
#include <string_view>
#include <vector>

namespace gw {

class CTextLines;
struct TKBVHJoint;

/// Turns the motion rows of a BVH file into keys of its joints, row by row. Values stand in the order of the
/// hierarchy, depth first, as many for each joint as it has channels.
class CBVHRowReader
{
public:
    /// Plans the columns under a root joint.
    CBVHRowReader(TKBVHJoint& root, CFailureRecord& record);

    /// Reads that many rows. False where the text ends before, and, with the reason in the record, for a row
    /// that is too short for the root or holds anything but finite numbers. Where a row is short for other
    /// joints, their later values move up.
    bool ReadRows(CTextLines& lines, size_t frameCount);
    /// Whether that many rows can stand in that many bytes.
    bool RowsFit(size_t frameCount, size_t byteCount) const;

private:
    struct Column
    {
        TKBVHJoint* joint;
        size_t first;               // index of the first value in a row
        std::vector<float> pending; // values that came late and do not fill a key yet
    };

    void AddColumns(TKBVHJoint& joint);
    void ReserveKeys(size_t frameCount, size_t byteCount);
    bool ReadRow(std::string_view row);
    bool ReadValues(std::string_view row);
    bool JudgeToken(std::string_view token, size_t index);
    bool CheckLength(bool blank);
    void AppendKeys();
    void AppendLate(Column& column);
    void FillLastKeys();
    void LookForDoubledOffsets();

    CFailureRecord& record_;
    std::vector<Column> m_kColumns;
    std::vector<float> m_kRow; // the values of one row
    size_t m_uiValues = 0;     // how many of them the row at hand had
    size_t m_uiRootValues;     // how many it must have
    size_t m_uiLine = 0;
    int m_iProbes;
};

} // namespace gw
