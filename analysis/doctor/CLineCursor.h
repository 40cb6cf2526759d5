#pragma once

#include "Text.h"

#include <cstddef>
#include <string_view>

namespace gw {

/// Iterates over the lines of a text in memory.
class CLineCursor
{
public:
    /// Starts at a byte of a text, which is on this line.
    explicit CLineCursor(std::string_view text, size_t begin = 0, size_t line = 1)
        : m_kText(text), m_kRest(text.substr(begin)), m_uiNext(line)
    {
    }

    /// Moves to the next line. False at the end of the text.
    bool Next()
    {
        if (!NextLine(m_kRest, m_kLine))
            return false;
        m_uiLine = m_uiNext++;
        return true;
    }
    /// Returns the current line without its end, and its number.
    std::string_view Line() const { return m_kLine; }
    size_t Number() const { return m_uiLine; }
    bool IsBlank() const { return m_kLine.find_first_not_of(kTokenDelimiters) == m_kLine.npos; }

    /// Returns where a part of the text starts.
    size_t OffsetOf(std::string_view part) const { return static_cast<size_t>(part.data() - m_kText.data()); }
    /// Returns where the next line starts.
    size_t NextOffset() const { return m_kText.size() - m_kRest.size(); }
    size_t NextNumber() const { return m_uiNext; }

private:
    std::string_view m_kText;
    std::string_view m_kRest;
    std::string_view m_kLine;
    size_t m_uiNext;
    size_t m_uiLine = 0;
};

} // namespace gw
