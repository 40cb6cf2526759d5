#pragma once

#include "CFailureRecord.h"

#include <cstddef>
#include <string_view>
#include <vector>

namespace gw {

class CTextLines;
struct TKBVHJoint;

/// Converts the motion rows of a BVH file to keys of its joints, row by row. Values are in hierarchy order,
/// depth first, one per channel of each joint.
class CBVHRowReader
{
public:
    /// Plans the columns of all joints under a root.
    CBVHRowReader(TKBVHJoint& root, CFailureRecord& record);

    /// Reads that many rows. Returns false if the text ends early or, with the reason in the record, if a row
    /// is too short for the root or contains anything but finite numbers. If a row is too short for other
    /// joints, the following values move up.
    bool ReadRows(CTextLines& lines, size_t frameCount);
    /// Returns whether that many rows fit into that many bytes.
    bool RowsFit(size_t frameCount, size_t byteCount) const;

private:
    struct Column
    {
        TKBVHJoint* joint;
        size_t first;               // index of its first value in a row
        std::vector<float> pending; // late values that do not yet fill a key
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
    std::vector<float> m_kRow; // values of the current row
    size_t m_uiValues = 0;     // number of values that the row had
    size_t m_uiRootValues;     // number of values that a row must have
    size_t m_uiLine = 0;
    int m_iProbes;
};

} // namespace gw
