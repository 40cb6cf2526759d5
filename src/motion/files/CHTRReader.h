#pragma once

#include "CFailureRecord.h"

#include <cstddef>
#include <set>
#include <span>
#include <string>
#include <string_view>

namespace gw {

class CTextLines;
struct TKHTRFile;
struct TKHTRSegment;

/// Reads an HTR file into records. A line starting with "[" starts a section. Sections come in any order, but
/// the header's segment count limits the hierarchy lines, and values of a segment that is not yet known are
/// lost. Unknown sections are skipped.
class CHTRReader
{
public:
    CHTRReader(CTextLines& lines, TKHTRFile& file, CFailureRecord& record)
        : lines_(lines), file_(file), record_(record)
    {
    }

    /// Reads all lines. Returns false, with the reason in the record, for an invalid section, a file without
    /// a hierarchy, or more frames than its size justifies.
    bool Read();

private:
    using Handler = bool (CHTRReader::*)(std::string_view section);
    struct HandlerRow
    {
        std::string_view section;
        Handler read;
    };
    static const HandlerRow kHandlers[];

    bool ReadSection(std::string_view section);
    bool ReadHeader(std::string_view section);
    bool ReadHierarchy(std::string_view section);
    bool ReadBasePosition(std::string_view section);
    bool ReadSegment(std::string_view section);

    bool NextSectionLine(std::string_view& line);
    bool ReadKey(std::string_view key, std::string_view rest);
    bool AddSegment(std::string_view line);
    void LinkSegments();
    bool IndexSegments();
    bool ReadBaseLine(std::string_view line);
    void ReserveRows(TKHTRSegment& segment);
    bool ReadRow(TKHTRSegment& segment, std::string_view line, std::span<float, 7> row);
    bool ReadNumbers(std::string_view text, std::span<float, 7> numbers, size_t& count);
    bool CheckFile();
    void WarnOfMissingRows();

    bool Fail(EFailure reason, std::string_view name);
    void Warn(EFailure reason, std::string_view name);

    CTextLines& lines_;
    TKHTRFile& file_;
    CFailureRecord& record_;
    std::set<std::string, std::less<>> m_kSegmentSections; // "[name]" of each segment with a parent
    size_t m_uiFramesLine = 0;                             // line of the key "NumFrames"
};

} // namespace gw
