#pragma once

#include "CFailureRecord.h"
#include "CFieldArchive.h"

#include <algorithm>
#include <span>
#include <string>

namespace gw {

class CMappedFile;

/// Fills fields from the bytes of a container without trusting them: a value that does not fit into the
/// remaining bytes is damage, and from there on every field reads as zero.
class CFieldReader : public CFieldArchive
{
public:
    CFieldReader(std::span<const std::byte> bytes, size_t position, CVersion version, CFailureRecord& record)
        : CFieldArchive(true, version), m_kBytes(bytes), m_uiPosition(std::min(position, bytes.size())),
          record_(record)
    {
    }

    void Text(const char* name, CText& text) override;
    bool Presence(const char* name, bool present) override;
    size_t Count(const char* name, size_t count, size_t leastBytes) override;
    size_t Fitting(int64_t count, size_t elementBytes) override;
    void Refuse(EFailure reason) override { Fail(reason); }

    /// Reads a length and the characters. Returns a view into the bytes.
    std::string_view ReadString();
    uint32_t ReadUnsigned();

    size_t Position() const { return m_uiPosition; }
    bool AtEnd() const { return m_uiPosition >= m_kBytes.size(); }
    bool IsDamaged() const { return static_cast<bool>(record_.Failure()); }
    /// Sets the file that the bytes are mapped from. Its pages are released once they are read, so a large
    /// block is not in memory twice.
    void SetSource(CMappedFile* file) { m_pkFile = file; }
    /// Starts an object: sets where its link ids go, and its class name for the failure record.
    void BeginObject(std::vector<uint32_t>& linkIDs, const char* className);

protected:
    void Values(const char* name, EFieldKind kind, void* values, size_t count) override;
    void Slot(const char* name, const CLinkSlot& slot) override;

private:
    size_t Remaining() const { return m_kBytes.size() - m_uiPosition; }
    void Fail(EFailure reason);
    void Copy(std::byte* to, size_t byteCount);

    std::span<const std::byte> m_kBytes;
    size_t m_uiPosition;
    CFailureRecord& record_;
    std::vector<uint32_t>* m_pkLinkIDs = nullptr;
    const char* m_pcClassName = "";
    CMappedFile* m_pkFile = nullptr;
    size_t m_uiForgotten = 0;
};

} // namespace gw
