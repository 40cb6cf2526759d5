#pragma once

#include "CByteSink.h"
#include "Numbers.h"

#include <cstdint>
#include <string>
#include <string_view>

namespace gw {

/// The platform's line end.
inline constexpr std::string_view kTextLineEnd =
#ifdef _WIN32
    "\r\n";
#else
    "\n";
#endif

/// Lines of text on their way into a sink. The text goes out in pieces, so that it is never in memory as a
/// whole.
class CLineWriter
{
public:
    explicit CLineWriter(CByteSink sink) : m_kSink(std::move(sink)) {}

    // Parts of a line, in the order of the calls; EndLine ends it with the platform's line end.
    CLineWriter& Text(std::string_view text);
    /// As "%d".
    CLineWriter& Int(int32_t value);
    /// As "%f". What is no finite number is written as 0: no reader takes anything else back.
    CLineWriter& Number(float value);
    /// In as many decimals as it takes to read the same number back.
    CLineWriter& Shortest(float value);
    void EndLine();
    void Line(std::string_view text);

    /// For rows that are formatted in one go: where that many bytes can be written. Taken says where they
    /// end.
    char* Room(size_t byteCount)
    {
        return m_kBuffer.size() - m_uiUsed >= byteCount ? m_kBuffer.data() + m_uiUsed : MakeRoom(byteCount);
    }
    void Taken(const char* end) { m_uiUsed = static_cast<size_t>(end - m_kBuffer.data()); }

    /// Hands on what is left. False when the sink refused anything since the start.
    bool Flush();

private:
    char* MakeRoom(size_t byteCount);

    static constexpr size_t kPieceBytes = size_t{1} << 16; // stays in the cache of a core

    CByteSink m_kSink;
    std::string m_kBuffer = std::string(kPieceBytes, '\0');
    size_t m_uiUsed = 0;
    bool m_bRefused = false;
};

} // namespace gw
