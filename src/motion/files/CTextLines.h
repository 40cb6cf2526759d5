#pragma once

#include "CFailureRecord.h"
#include "CMappedFile.h"

#include <cstddef>
#include <functional>
#include <string>
#include <string_view>
#include <utility>

namespace gw {

/// A cursor over the lines of a text file. The file is mapped, not copied; views stay valid until the next
/// Open or Close. LF and CR LF end lines, a byte order mark is skipped, a single CR is an ordinary character.
class CTextLines
{
public:
    /// Longer lines are returned in pieces of this length. Readers of keywords treat each piece as a line.
    static constexpr size_t kPieceLength = 4095;

    /// Opens a file in place of the current one, at its start. Returns None on success; after a failure,
    /// there are no lines.
    EFailure Open(const std::string& path);
    void Close();

    /// Reads the next line, or the next piece of a long one, without its line end. False at the end of the
    /// text.
    bool Next(std::string_view& line);
    /// Reads the rest of the current line, however long. False at the end of the text.
    bool NextRow(std::string_view& row);
    /// Moves the cursor back before the last line or piece.
    void StepBack();

    /// Returns the number of the last line read, starting at 1; 0 before the first.
    size_t LineNumber() const { return m_kNow.m_uiLine; }
    size_t BytesLeft() const { return m_kFile.Text().size() - m_kNow.m_uiOffset; }
    size_t ByteCount() const { return m_kFile.Text().size(); }
    /// See CMappedFile.
    bool IsWhole() const { return m_kFile.IsWhole(); }
    /// Releases the memory of the lines read so far, if that is worth a system call, and reports progress.
    void ForgetRead();
    /// Sets a function that ForgetRead calls from time to time with the number of bytes read and the total.
    void SetProgress(std::function<void(size_t, size_t)> progress) { progress_ = std::move(progress); }

private:
    struct Cursor
    {
        size_t m_uiOffset = 0;
        size_t m_uiLine = 0;
        bool m_bInsideLine = false; ///< the next piece continues the same line
    };

    std::string_view BeginRead();

    CMappedFile m_kFile;
    Cursor m_kNow;
    Cursor m_kBefore;
    size_t m_uiForgotten = 0;
    size_t m_uiReported = 0;
    std::function<void(size_t, size_t)> progress_;
};

/// Returns a word or line of a file, shortened for a failure record.
std::string Quote(std::string_view text);

} // namespace gw
