#pragma once

#include "CFailureRecord.h"
#include "TKCHFile.h"

#include <array>
#include <cstddef>
#include <span>
#include <string_view>
#include <vector>

namespace gw {

class CTextLines;

/// Reads a CHA file into records. The first word of a line determines its meaning; a line without a word
/// closes the header or, outside it, ends the file. In the other sections, only lines that start with a
/// character from "?" on are read.
class CCHAReader
{
public:
    CCHAReader(CTextLines& lines, TKCHFile& file, CFailureRecord& record)
        : lines_(lines), file_(file), record_(record), m_kPlaces(kSegmentLimit)
    {
    }

    /// Reads all lines. Returns false, with the reason in the record, for an invalid section and for a file
    /// without a root segment or a motion.
    bool Read();

private:
    using Handler = bool (CCHAReader::*)();
    struct HandlerRow
    {
        std::string_view section;
        Handler read;
    };
    static const HandlerRow kHandlers[];

    /// A row's numbers: the matrix row by row, then the position.
    using Row = std::array<float, 12>;
    /// An entry of the work array: the rows at one position of every frame.
    struct Place
    {
        TKCHSegment segment;
        size_t rowCount = 0;
        Row row{}; // the last row, which completes a short one
    };

    bool ReadWord(std::string_view word, std::string_view rest);
    bool ReadKey(std::string_view key, int& field, std::string_view rest);
    bool OpenHeader();
    void CloseHeader();
    bool ReadLengths();
    bool ReadHierarchy();
    bool ReadMotion();

    bool NextSectionLine(std::string_view& line);
    bool ReadLength(std::string_view line);
    bool AddSegment(std::string_view line, bool& counts);
    std::span<Place> CountedPlaces();
    bool ReservePlaces();
    bool ReadRow(size_t index, std::string_view line);
    bool ReadNumbers(std::string_view text, Row& row, size_t& count);
    bool TakeFrames();
    void TakeFrames(Place& place);
    bool CheckFile(EFailure end);

    bool Fail(EFailure reason, std::string_view name);
    void Warn(EFailure reason, std::string_view name);

    CTextLines& lines_;
    TKCHFile& file_;
    CFailureRecord& record_;
    size_t m_uiOpenHeaders = 0; // headers can be nested, and each is closed by its own blank line
    bool m_bHasMotion = false;
    std::vector<Place> m_kPlaces;
};

} // namespace gw
