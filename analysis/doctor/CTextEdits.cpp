#include "CTextEdits.h"

#include <algorithm>

namespace gw {

void CTextEdits::Replace(size_t begin, size_t length, std::string_view instead)
{
    const bool goesOn = !m_kEdits.empty() && instead.empty() && m_kEdits.back().insteadLength == 0 &&
                        m_kEdits.back().begin + m_kEdits.back().length == begin;
    if (goesOn)
        m_kEdits.back().length += length;
    else if (m_kEdits.size() < kMost)
        Add(begin, length, instead);
}

void CTextEdits::Add(size_t begin, size_t length, std::string_view instead)
{
    m_kEdits.push_back({begin, length, m_kInstead.size(), instead.size()});
    m_kInstead += instead;
}

bool CTextEdits::Write(std::string_view text, const CTextSink& write)
{
    std::ranges::stable_sort(m_kEdits, {}, &Edit::begin);
    const std::string_view insteads = m_kInstead;
    std::string written;
    size_t at = 0;
    for (const Edit& edit : m_kEdits)
    {
        written += text.substr(at, edit.begin - at);
        written += insteads.substr(edit.firstInstead, edit.insteadLength);
        at = edit.begin + edit.length;
    }
    written += text.substr(at);
    return write(written);
}

} // namespace gw
