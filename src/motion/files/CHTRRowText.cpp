#include "CHTRRowText.h"

#include "CLineWriter.h"
#include "SystemConventions.h"

#include <bit>
#include <cmath>
#include <cstdint>
#include <cstring>

namespace gw {

namespace {

bool IsSame(float a, float b)
{
    return std::bit_cast<uint32_t>(a) == std::bit_cast<uint32_t>(b);
}

bool IsSame(const Vec3& a, const Vec3& b)
{
    return IsSame(a.x, b.x) && IsSame(a.y, b.y) && IsSame(a.z, b.z);
}

char* WriteColumn(char* out, float value)
{
    *out = ' ';
    return WriteFixed6(out + 1, std::isfinite(value) ? value : 0.0f);
}

char* WriteColumns(char* out, const Vec3& v)
{
    return WriteColumn(WriteColumn(WriteColumn(out, v.x), v.y), v.z);
}

} // namespace

// Returns where the text after the translation starts.
char* CHTRRowText::WriteTranslation(const Vec3& translation)
{
    if (!m_bHasLast || !IsSame(translation, m_kLast.translation))
        m_uiTranslation = static_cast<size_t>(WriteColumns(m_acText, translation) - m_acText);
    return m_acText + m_uiTranslation;
}

char* CHTRRowText::WriteScale(char* out, float scale)
{
    if (!m_bHasLast || !IsSame(scale, m_kLast.scale))
    {
        char* const end = WriteColumn(m_acScale, scale);
        std::memcpy(end, kLineEnd.data(), kLineEnd.size());
        m_uiScale = static_cast<size_t>(end - m_acScale) + kLineEnd.size();
    }
    std::memcpy(out, m_acScale, m_uiScale);
    return out + m_uiScale;
}

void CHTRRowText::Write(CLineWriter& out, int number, const HTRRow& row)
{
    char* const end = WriteScale(WriteColumns(WriteTranslation(row.translation), row.degrees), row.scale);
    m_uiText = static_cast<size_t>(end - m_acText);
    m_kLast = row;
    m_bHasLast = true;
    Repeat(out, number);
}

void CHTRRowText::Repeat(CLineWriter& out, int number) const
{
    char* const text = WriteInt(out.Room(kIntBytes + sizeof(m_acText)), number);
    std::memcpy(text, m_acText, m_uiText);
    out.Taken(text + m_uiText);
}

} // namespace gw
