#pragma once

#include "CFailure.h"
#include "TKCHFile.h"

#include <array>
#include <cstddef>
#include <span>
#include <string_view>
#include <vector>

namespace gw {

class CTextLines;

/// Reads a CHA file into records. The first word of a line says what it is; a line without a word closes the
/// header or, outside it, ends the file. Inside the other sections a line counts only where it begins with a
/// character from "?" on.
class CCHAReader
{
public:
    CCHAReader(CTextLines& lines, TKCHFile& file, CFailureRecord& record)
        : lines_(lines), file_(file), record_(record), m_kPlaces(kSegmentLimit)
    {
    }

    /// Reads all lines. False, with the reason in the record, for a section that is no good and for a file
    /// without a root segment or without a motion.
    bool Read();

private:
    using Handler = bool (CCHAReader::*)();
    struct HandlerRow
    {
        std::string_view section;
        Handler read;
    };
    static const HandlerRow kHandlers[];

    /// The numbers of a row: the matrix row by row, then the position.
    using Row = std::array<float, 12>;
    /// An entry of the work array: the rows that stand at one place of every frame.
    struct Place
    {
        TKCHSegment segment;
        size_t rowCount = 0;
        Row row{}; // the last one, which fills up a row that is short
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
    size_t m_uiOpenHeaders = 0; // a header may stand in a header, and each takes a blank line of its own
    bool m_bHasMotion = false;
    std::vector<Place> m_kPlaces;
};

} // namespace gw
