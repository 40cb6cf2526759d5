#pragma once

#include "CByteSink.h"
#include "CFieldArchive.h"

#include <functional>
#include <span>
#include <string_view>

namespace gw {

/// Writes fields in the container format. Small values are buffered; large blocks go directly to the sink.
class CFieldWriter : public CFieldArchive
{
public:
    /// `linkID` returns an object's id in this file.
    CFieldWriter(CByteSink sink, std::function<uint32_t(const CObject*)> linkID);

    void Text(const char* name, CText& text) override;
    bool Presence(const char* name, bool present) override;
    size_t Count(const char* name, size_t count, size_t leastBytes) override;
    /// The content is not available, so the file must not be kept.
    void Refuse(EFailure) override { m_bRefused = true; }

    void WriteString(std::string_view text);
    void WriteUnsigned(uint32_t value);
    void WriteBytes(std::span<const std::byte> bytes);
    /// Flushes the buffered bytes. Returns false if the sink or a class has failed since the start.
    bool Flush();

protected:
    void Values(const char* name, EFieldKind kind, void* values, size_t count) override;
    void Slot(const char* name, const CLinkSlot& slot) override;

private:
    CByteSink m_kSink;
    std::function<uint32_t(const CObject*)> linkID_;
    std::vector<std::byte> m_kGathered;
    bool m_bRefused = false;
};

} // namespace gw
