#pragma once

#include "CSafeFile.h"
#include "Numbers.h"

#include <cstdint>
#include <string>
#include <string_view>

namespace gw {

/// Lines of text on their way into a file that is replaced in one step. The text goes out in pieces, so that
/// it is never in memory as a whole.
class CLineWriter
{
public:
    bool Open(const std::string& path) { return m_kFile.Open(path); }

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

    /// Writes what is left and puts the file in its place. False when anything failed on the way; the old
    /// file stands.
    bool Commit();

private:
    char* Room(size_t byteCount);
    void Flush();

    static constexpr size_t kPieceBytes = size_t{1} << 20;

    CSafeFile m_kFile;
    std::string m_kBuffer = std::string(kPieceBytes, '\0');
    size_t m_uiUsed = 0;
};

} // namespace gw
