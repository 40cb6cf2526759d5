#pragma once

#include "CByteSink.h"

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

/// Replacements in a text, which itself is not changed. They can be added in any order but must not overlap;
/// of two at one place, the first one is applied first. Edits beyond kMost are ignored: such a text is not a
/// motion, and repairing it must not take much memory.
class CTextEdits
{
public:
    static constexpr size_t kMost = size_t{1} << 19;

    /// Replaces `length` bytes starting at `begin` by `instead`.
    void Replace(size_t begin, size_t length, std::string_view instead);

    /// Writes the text with all edits applied. Returns what `write` returns.
    bool Write(std::string_view text, const CTextSink& write);

private:
    struct Edit
    {
        size_t begin;
        size_t length;
        size_t firstInstead; // offset in m_kInstead
        size_t insteadLength;
    };

    void Add(size_t begin, size_t length, std::string_view instead);

    std::vector<Edit> m_kEdits;
    std::string m_kInstead; // all replacement texts, concatenated
};

} // namespace gw
