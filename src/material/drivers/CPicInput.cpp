#include "CPicInput.h"

#include "Files.h"
#include "Paths.h"

#include <algorithm>
#include <array>
#include <cstring>

namespace gw {

bool IsStandardStream(const std::string& fileName)
{
    const PathParts parts = SplitPath(fileName);
    return parts.folder.empty() && parts.stem == "-";
}

bool CPicInput::Open(const std::string& fileName)
{
    m_uiPosition = 0;
    if (IsStandardStream(fileName))
    {
        m_pkStream = BinaryInput();
        m_iStreamStart = std::ftell(m_pkStream);
        return true;
    }
    const bool opened = m_kFile.Open(fileName) == EFailure::None;
    m_kBytes = m_kFile.Bytes();
    return opened;
}

bool CPicInput::Read(std::span<std::byte> bytes)
{
    if (bytes.empty())
        return true;
    if (IsStream())
    {
        const size_t count = std::fread(bytes.data(), 1, bytes.size(), m_pkStream);
        m_uiPosition += count;
        return count == bytes.size();
    }
    if (!MayHold(bytes.size()))
        return false;
    std::memcpy(bytes.data(), m_kBytes.data() + m_uiPosition, bytes.size());
    m_uiPosition += bytes.size();
    return true;
}

bool CPicInput::Seek(uint64_t position)
{
    if (!IsStream())
    {
        m_uiPosition = position;
        return MayHold(0);
    }
    if (position < m_uiPosition)
    {
        const long target = m_iStreamStart + static_cast<long>(position);
        if (m_iStreamStart < 0 || std::fseek(m_pkStream, target, SEEK_SET) != 0)
            return false;
        m_uiPosition = position;
    }
    std::array<std::byte, 4096> passed;
    while (m_uiPosition < position)
    {
        const uint64_t step = std::min<uint64_t>(position - m_uiPosition, passed.size());
        if (!Read(std::span(passed).first(static_cast<size_t>(step))))
            return false;
    }
    return true;
}

} // namespace gw
