#include "CFieldWriter.h"

namespace gw {

namespace {

constexpr size_t kGatherBytes = size_t{1} << 16;

} // namespace

CFieldWriter::CFieldWriter(CByteSink sink, std::function<uint32_t(const CObject*)> linkID)
    : CFieldArchive(false, kNewestVersion), m_kSink(std::move(sink)), linkID_(std::move(linkID))
{
    m_kGathered.reserve(kGatherBytes);
}

void CFieldWriter::WriteBytes(std::span<const std::byte> bytes)
{
    if (m_kGathered.size() + bytes.size() > kGatherBytes)
        Flush();
    if (bytes.size() > kGatherBytes)
        m_bRefused |= !m_kSink(bytes);
    else
        m_kGathered.insert(m_kGathered.end(), bytes.begin(), bytes.end());
}

bool CFieldWriter::Flush()
{
    if (!m_kGathered.empty())
        m_bRefused |= !m_kSink(m_kGathered);
    m_kGathered.clear();
    return !m_bRefused;
}

void CFieldWriter::WriteUnsigned(uint32_t value)
{
    WriteBytes(std::as_bytes(std::span(&value, 1)));
}

void CFieldWriter::WriteString(std::string_view text)
{
    WriteUnsigned(static_cast<uint32_t>(text.size()));
    WriteBytes(std::as_bytes(std::span(text)));
}

void CFieldWriter::Text(const char*, CText& text)
{
    WriteString(text.View());
}

bool CFieldWriter::Presence(const char*, bool present)
{
    WriteUnsigned(present ? 1 : 0);
    return present;
}

size_t CFieldWriter::Count(const char*, size_t count, size_t)
{
    WriteUnsigned(static_cast<uint32_t>(count));
    return count;
}

void CFieldWriter::Values(const char*, EFieldKind kind, void* values, size_t count)
{
    WriteBytes({static_cast<const std::byte*>(values), count * FieldBytes(kind)});
}

void CFieldWriter::Slot(const char*, const CLinkSlot& slot)
{
    WriteUnsigned(linkID_(slot.Get()));
}

} // namespace gw
