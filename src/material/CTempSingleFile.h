#pragma once

#include "CTempFile.h"

namespace gw {

/// A temporary file of exactly one block, with index 0.
class CTempSingleFile : public CTempFile
{
public:
    CTempSingleFile(const std::string& folder, uint64_t byteCount) : CTempFile(folder, byteCount, false) {}
    ~CTempSingleFile() override;

    std::optional<uint32_t> Allocate(uint64_t byteCount) override;
    bool Free(uint32_t block) override;
    std::byte* Map(uint32_t block) override;
    void Unmap(uint32_t block) override;

private:
    bool IsBlock(uint32_t block) const { return block == 0 && m_kView.m_uiSize > 0; }

    View m_kView; // empty until the block is allocated
};

} // namespace gw
