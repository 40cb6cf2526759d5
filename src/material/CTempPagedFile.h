#pragma once

#include "CTempFile.h"

#include <array>
#include <map>

namespace gw {

/// A temporary file of 64 MiB for many blocks, allocated in pages of 64 KiB. A block's index is its first
/// page.
class CTempPagedFile : public CTempFile
{
public:
    static constexpr uint64_t kPageBytes = 65'536;
    static constexpr uint32_t kPageCount = 1'024;
    static constexpr uint64_t kFileBytes = kPageBytes * kPageCount;

    explicit CTempPagedFile(const std::string& folder) : CTempFile(folder, kFileBytes, true) {}
    ~CTempPagedFile() override;

    std::optional<uint32_t> Allocate(uint64_t byteCount) override;
    bool Free(uint32_t block) override;
    std::byte* Map(uint32_t block) override;
    void Unmap(uint32_t block) override;

private:
    std::optional<uint32_t> FirstFit(uint32_t pageCount) const;

    std::array<uint8_t, kPageCount> m_abPageInUse{};
    std::map<uint32_t, View> m_kBlocks; // by first page
};

} // namespace gw
