#include "CBitArray.h"

#include "CFieldArchive.h"

#include <algorithm>

namespace gw {

CBitArray::CBitArray(int32_t bitCount)
    : m_iBitCount(std::max(bitCount, 0)), m_iWordCount(m_iBitCount / 32 + (m_iBitCount % 32 ? 1 : 0))
{
    m_kWords.resize(static_cast<size_t>(m_iWordCount));
}

void CBitArray::Fields(CFieldArchive& archive, const char* name)
{
    archive.Signed("bit count", m_iBitCount);
    archive.Signed("word count", m_iWordCount);
    archive.OptionalBlock(name, m_kWords, m_iWordCount);
}

bool CBitArray::Holds(size_t bit) const
{
    return m_iBitCount > 0 && bit < static_cast<size_t>(m_iBitCount) && bit / 32 < m_kWords.size();
}

void CBitArray::Set(size_t bit)
{
    if (Holds(bit))
        m_kWords[bit / 32] |= 1u << bit % 32;
}

void CBitArray::Clear(size_t bit)
{
    if (Holds(bit))
        m_kWords[bit / 32] &= ~(1u << bit % 32);
}

} // namespace gw
