#include "CSpool.h"

#include "CSafeFile.h"

#include <array>

namespace gw {

CSpool::CSpool() : m_pkFile(std::tmpfile()) {}

CSpool::~CSpool()
{
    if (m_pkFile)
        std::fclose(m_pkFile);
}

void CSpool::Write(std::string_view text)
{
    if (m_pkFile)
        std::fwrite(text.data(), 1, text.size(), m_pkFile); // a failure stays in the stream's error mark
}

bool CSpool::CopyTo(CSafeFile& file)
{
    if (!m_pkFile || std::fflush(m_pkFile) != 0 || std::ferror(m_pkFile))
        return false;
    std::rewind(m_pkFile); // takes the mark away
    std::array<char, size_t{1} << 16> buffer;
    while (const size_t count = std::fread(buffer.data(), 1, buffer.size(), m_pkFile))
    {
        if (!file.Write(std::string_view(buffer.data(), count)))
            return false;
    }
    return !std::ferror(m_pkFile);
}

} // namespace gw
