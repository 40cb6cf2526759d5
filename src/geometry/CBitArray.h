#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

namespace gw {

class CFieldArchive;

/// A row of bits. Files may count more bits than there are words for; those read as 0.
class CBitArray
{
public:
    CBitArray() = default;
    /// So many bits, all 0; none for a count below 1.
    explicit CBitArray(int32_t bitCount);

    /// Both counts, a presence word and the words, as every holder stores them.
    void Fields(CFieldArchive& archive, const char* name);

    int32_t GetBitCount() const { return m_iBitCount; }
    uint64_t MemoryUsed() const { return 12 + m_kWords.size() * sizeof(uint32_t); }
    /// False for a bit that is not there.
    bool Test(size_t bit) const { return Holds(bit) && (m_kWords[bit / 32] >> bit % 32 & 1u); }
    /// Nothing happens for a bit that is not there.
    void Set(size_t bit);
    void Clear(size_t bit);

private:
    bool Holds(size_t bit) const;

    std::vector<uint32_t> m_kWords;
    // Counts as files have them: they may stand without words, and then bound nothing.
    int32_t m_iBitCount = 0;
    int32_t m_iWordCount = 0;
};

} // namespace gw
