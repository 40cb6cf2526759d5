#include "CLineWriter.h"

#include <cmath>
#include <cstring>

namespace gw {

bool CLineWriter::Flush()
{
    if (m_uiUsed > 0 && !m_bRefused)
        m_bRefused = !m_kSink(std::as_bytes(std::span(m_kBuffer).first(m_uiUsed)));
    m_uiUsed = 0;
    return !m_bRefused;
}

char* CLineWriter::MakeRoom(size_t byteCount)
{
    Flush();
    if (m_kBuffer.size() < byteCount)
        m_kBuffer.resize(byteCount);
    return m_kBuffer.data() + m_uiUsed;
}

CLineWriter& CLineWriter::Text(std::string_view text)
{
    std::memcpy(Room(text.size()), text.data(), text.size());
    m_uiUsed += text.size();
    return *this;
}

CLineWriter& CLineWriter::Int(int32_t value)
{
    char* const begin = Room(kIntBytes);
    m_uiUsed += static_cast<size_t>(WriteInt(begin, value) - begin);
    return *this;
}

CLineWriter& CLineWriter::Number(float value)
{
    char* const begin = Room(kFixed6Bytes);
    m_uiUsed += static_cast<size_t>(WriteFixed6(begin, std::isfinite(value) ? value : 0.0f) - begin);
    return *this;
}

CLineWriter& CLineWriter::Shortest(float value)
{
    char* const begin = Room(kShortestBytes);
    m_uiUsed += static_cast<size_t>(WriteShortest(begin, std::isfinite(value) ? value : 0.0f) - begin);
    return *this;
}

void CLineWriter::EndLine()
{
    Text(kTextLineEnd);
}

void CLineWriter::Line(std::string_view text)
{
    Text(text).EndLine();
}

} // namespace gw
