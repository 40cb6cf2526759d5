#pragma once

#include "CByteSink.h"
#include "CObject.h"

#include <cstddef>
#include <memory>
#include <span>

namespace gw {

class CMappedFile;

/// A tagged object that a container stores without interpreting it. Any object can have a chain of them.
class CCustomData : public CObject
{
public:
    static const CRTTI ms_kRTTI;

    CCustomData();
    CCustomData(const CCustomData& source);
    ~CCustomData() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    void Fields(CFieldArchive& archive) override;
    /// Writes nothing: custom data has no tables, and no page links to it.
    void DumpTable(CHTMLTables&) override {}
    uint64_t GetMemoryUsed() const override;

    /// Stores a copy of a free text (may be null) and a version as major x 100 + minor.
    void SetCreator(const char* creator, uint32_t major, uint32_t minor);
    const char* GetCreator() const { return m_pcCreator.Get(); }
    uint32_t GetCreatorVersion() const { return m_uiCreatorVersion; }
    /// Returns a word for the creator's own use.
    void SetUserWord(uint32_t word) { m_uiUserWord = word; }
    uint32_t GetUserWord() const { return m_uiUserWord; }
    CCustomData* GetNextData() const { return m_spkNextData.Get(); }
    void SetNextData(CCustomData* next) { m_spkNextData = next; }

private:
    CText m_pcCreator;
    uint32_t m_uiCreatorVersion = 0;
    uint32_t m_uiUserWord = 0;
    Held<CCustomData> m_spkNextData;
};

/// Custom data that is a block of bytes.
class CRawData : public CCustomData
{
public:
    static const CRTTI ms_kRTTI;

    CRawData();
    CRawData(const CRawData& source);
    ~CRawData() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override;
    void Fields(CFieldArchive& archive) override;
    uint64_t GetMemoryUsed() const override;

    /// Stores a copy of the bytes; without bytes, the block is removed.
    void SetData(std::span<const std::byte> bytes) { SetData(std::vector(bytes.begin(), bytes.end())); }
    void SetData(std::vector<std::byte>&& bytes);
    /// Refers to the bytes of a file of at most 4 GiB without copying them.
    void SetData(CMappedFile&& file);
    std::span<const std::byte> Data() const { return {m_pbyData.get(), m_uiDataSize}; }
    /// Returns whether the file that contains the bytes is still complete; see CMappedFile.
    bool IsWhole() const;
    /// Sends the bytes to a sink in pieces, releasing the memory of a mapped file piece by piece. Returns
    /// false as soon as the sink does, and if the file was not complete.
    bool WriteData(const CByteSink& sink) const;

private:
    uint32_t m_uiDataSize = 0;
    std::shared_ptr<const std::byte> m_pbyData; // shared by copies of the object; never modified once set
    std::shared_ptr<CMappedFile> m_spkFile;     // contains the block; null for a block in memory
};

/// Five texts about a file's author. Its class record names CObject as base, although it is a CCustomData in
/// every other respect.
class CAuthorInfo : public CCustomData
{
public:
    static const CRTTI ms_kRTTI;

    CAuthorInfo();
    CAuthorInfo(const CAuthorInfo& source);
    ~CAuthorInfo() override;
    const CRTTI* GetRTTI() const override { return &ms_kRTTI; }
    CObject* CreateClone() const override;
    void Fields(CFieldArchive& archive) override;
    uint64_t GetMemoryUsed() const override;

private:
    CText m_apcText[5];
};

} // namespace gw
