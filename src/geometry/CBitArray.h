#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

namespace gw {

class CFieldArchive;

/// An array of bits. Files may count more bits than they have words for; the missing bits read as 0.
class CBitArray
{
public:
    CBitArray() = default;
    /// Creates that many bits, all 0; empty for a count below 1.
    explicit CBitArray(int32_t bitCount);

    /// The stored form: both counts, a presence word and the words.
    void Fields(CFieldArchive& archive, const char* name);

    int32_t GetBitCount() const { return m_iBitCount; }
    uint64_t MemoryUsed() const { return 12 + m_kWords.size() * sizeof(uint32_t); }
    /// Returns a bit; false if it does not exist.
    bool Test(size_t bit) const { return Holds(bit) && (m_kWords[bit / 32] >> bit % 32 & 1u); }
    /// Sets a bit; ignored if it does not exist.
    void Set(size_t bit);
    void Clear(size_t bit);

private:
    bool Holds(size_t bit) const;

    std::vector<uint32_t> m_kWords;
    // Counts as stored in files. Without words they limit nothing.
    int32_t m_iBitCount = 0;
    int32_t m_iWordCount = 0;
};

} // namespace gw
