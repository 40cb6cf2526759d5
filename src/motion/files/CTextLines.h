#pragma once

#include "CFailure.h"
#include "CMappedFile.h"

#include <cstddef>
#include <string>
#include <string_view>

namespace gw {

/// A text file as a cursor over its lines. The file is mapped and never copied; views stay valid until the
/// next Open or Close. LF and CR LF end lines, a byte order mark is skipped, a lone CR is an ordinary
/// character.
class CTextLines
{
public:
    /// A longer line arrives in pieces of this many characters, each taken for a line by the readers of
    /// keywords.
    static constexpr size_t kPieceLength = 4095;

    /// Replaces the text and rewinds. None on success, else why not; no lines then.
    EFailure Open(const std::string& path);
    void Close();

    /// The next line, or the next piece of a long one, without its line end. False when the text is used up.
    bool Next(std::string_view& line);
    /// All that is left of the line at the cursor, however long. False when the text is used up.
    bool NextRow(std::string_view& row);
    /// Puts the cursor back before what was read last, so that it is read again.
    void StepBack();

    /// The line that was read last, from 1 on as an editor counts; 0 before the first.
    size_t LineNumber() const { return m_kNow.m_uiLine; }
    size_t BytesLeft() const { return m_kFile.Text().size() - m_kNow.m_uiOffset; }
    size_t ByteCount() const { return m_kFile.Text().size(); }
    /// See CMappedFile.
    bool IsWhole() const { return m_kFile.IsWhole(); }
    /// Gives back the memory of what was read so far, when that is worth a call of the system.
    void ForgetRead();

private:
    struct Cursor
    {
        size_t m_uiOffset = 0;
        size_t m_uiLine = 0;
        bool m_bInsideLine = false; ///< the next piece goes on with the same line
    };

    std::string_view BeginRead();

    CMappedFile m_kFile;
    Cursor m_kNow;
    Cursor m_kBefore;
    size_t m_uiForgotten = 0;
};

/// A word or line of a file for a failure record: its beginning, however long it is.
std::string Quote(std::string_view text);

} // namespace gw
