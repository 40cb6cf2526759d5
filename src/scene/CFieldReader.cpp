// Reads fields from a byte range. The first value that does not fit marks the reader as damaged; every later
// field reads as zero without touching the bytes, so callers check for damage only once per object.

#include "CFieldReader.h"

#include "CMappedFile.h"

#include <cstring>

namespace gw {

namespace {

constexpr size_t kForgetBytes = size_t{16} << 20; // rare enough to cost nothing

} // namespace

void CFieldReader::Fail(EFailure reason)
{
    record_.Fail(reason, m_uiPosition, m_pcClassName);
}

void CFieldReader::BeginObject(std::vector<uint32_t>& linkIDs, const char* className)
{
    m_pkLinkIDs = &linkIDs;
    m_pcClassName = className;
}

uint32_t CFieldReader::ReadUnsigned()
{
    uint32_t value = 0;
    Values("", EFieldKind::Unsigned, &value, 1);
    return value;
}

std::string_view CFieldReader::ReadString()
{
    const size_t length = Fitting(ReadUnsigned(), 1);
    const char* text = reinterpret_cast<const char*>(m_kBytes.data()) + m_uiPosition;
    m_uiPosition += length;
    return {text, length};
}

void CFieldReader::Text(const char*, CText& text)
{
    text.SetBytes(ReadString());
}

bool CFieldReader::Presence(const char*, bool)
{
    return ReadUnsigned() != 0;
}

size_t CFieldReader::Count(const char*, size_t, size_t leastBytes)
{
    return Fitting(ReadUnsigned(), leastBytes);
}

size_t CFieldReader::Fitting(int64_t count, size_t elementBytes)
{
    if (count <= 0 || IsDamaged())
        return 0;
    if (static_cast<uint64_t>(count) > Remaining() / elementBytes)
    {
        Fail(EFailure::BadCount);
        return 0;
    }
    return static_cast<size_t>(count);
}

void CFieldReader::Copy(std::byte* to, size_t byteCount)
{
    while (byteCount > 0)
    {
        const size_t piece = std::min(byteCount, kForgetBytes);
        std::memcpy(to, m_kBytes.data() + m_uiPosition, piece);
        to += piece;
        m_uiPosition += piece;
        byteCount -= piece;
        if (m_pkFile && m_uiPosition - m_uiForgotten >= kForgetBytes)
            m_pkFile->Forget(m_uiForgotten = m_uiPosition);
    }
}

void CFieldReader::Values(const char*, EFieldKind kind, void* values, size_t count)
{
    const size_t byteCount = count * FieldBytes(kind);
    if (byteCount == 0)
        return;
    if (IsDamaged() || byteCount > Remaining())
    {
        if (!IsDamaged())
            Fail(EFailure::Truncated);
        std::memset(values, 0, byteCount);
        return;
    }
    if (kind == EFieldKind::Bool)
        *static_cast<bool*>(values) = m_kBytes[m_uiPosition++] != std::byte{0};
    else
        Copy(static_cast<std::byte*>(values), byteCount);
}

void CFieldReader::Slot(const char*, const CLinkSlot&)
{
    m_pkLinkIDs->push_back(ReadUnsigned());
}

} // namespace gw
