#include "CLineWriter.h"

#include "SystemConventions.h"

#include <algorithm>
#include <cmath>
#include <cstring>
#include <utility>

namespace gw {

void CLineWriter::Send(size_t begin, size_t byteCount)
{
    if (byteCount > 0 && !m_bRefused)
        m_bRefused = !m_kSink(std::as_bytes(std::span(m_kBuffer).subspan(begin, byteCount)));
}

bool CLineWriter::Flush()
{
    Send(0, std::exchange(m_uiUsed, 0));
    return !m_bRefused;
}

char* CLineWriter::MakeRoom(size_t byteCount)
{
    size_t sent = 0;
    for (; m_uiUsed - sent >= kPieceBytes; sent += kPieceBytes)
        Send(sent, kPieceBytes);
    m_uiUsed -= sent;
    std::memmove(m_kBuffer.data(), m_kBuffer.data() + sent, m_uiUsed);
    if (m_kBuffer.size() - m_uiUsed < byteCount)
        m_kBuffer.resize(m_uiUsed + byteCount);
    return m_kBuffer.data() + m_uiUsed;
}

CLineWriter& CLineWriter::Text(std::string_view text)
{
    std::ranges::copy(text, Room(text.size())); // of an empty text, the address may be null
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
    Text(kLineEnd);
}

void CLineWriter::Line(std::string_view text)
{
    Text(text).EndLine();
}

} // namespace gw
