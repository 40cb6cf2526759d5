#pragma once

#include "CByteSink.h"
#include "Numbers.h"

#include <cstdint>
#include <string>
#include <string_view>

namespace gw {

/// Writes lines of text to a sink in pieces, so the whole text is never in memory. All pieces but the last
/// have the same size, a power of two: a file system stores a file that grows in such steps in fewer, larger
/// pages.
class CLineWriter
{
public:
    explicit CLineWriter(CByteSink sink) : m_kSink(std::move(sink)) {}

    // Parts of a line, in call order; EndLine ends it with the platform's line end.
    CLineWriter& Text(std::string_view text);
    /// Formats like "%d".
    CLineWriter& Int(int32_t value);
    /// Formats like "%f". A number that is not finite becomes 0, because readers accept nothing else.
    CLineWriter& Number(float value);
    /// Formats with as many decimals as needed to read back the same number.
    CLineWriter& Shortest(float value);
    void EndLine();
    void Line(std::string_view text);

    /// Returns memory for that many bytes, for rows that are formatted in one step. Taken sets their end.
    char* Room(size_t byteCount)
    {
        return m_kBuffer.size() - m_uiUsed >= byteCount ? m_kBuffer.data() + m_uiUsed : MakeRoom(byteCount);
    }
    void Taken(const char* end) { m_uiUsed = static_cast<size_t>(end - m_kBuffer.data()); }

    /// Flushes the rest. Returns false if the sink has failed since the start.
    bool Flush();

private:
    char* MakeRoom(size_t byteCount);

    void Send(size_t begin, size_t byteCount);

    static constexpr size_t kPieceBytes = size_t{1} << 16; // fits into a core's cache
    static constexpr size_t kSpareBytes = 4096;            // for the line that completes a piece

    CByteSink m_kSink;
    std::string m_kBuffer = std::string(kPieceBytes + kSpareBytes, '\0');
    size_t m_uiUsed = 0;
    bool m_bRefused = false;
};

} // namespace gw
