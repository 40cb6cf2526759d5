#pragma once

#include <cstdio>
#include <cstdlib>
#include <string>

namespace gw {

/// A file in memory, for writers that know files only.
class CTextFile
{
public:
    CTextFile() : m_pkFile(open_memstream(&m_pcText, &m_uiSize)) {}
    ~CTextFile()
    {
        if (m_pkFile)
            std::fclose(m_pkFile);
        std::free(m_pcText);
    }
    CTextFile(const CTextFile&) = delete;
    CTextFile& operator=(const CTextFile&) = delete;

    /// Null where there is no memory.
    std::FILE* File() { return m_pkFile; }
    /// What was written up to now.
    std::string Text()
    {
        if (m_pkFile)
            std::fflush(m_pkFile);
        return m_pcText ? std::string(m_pcText, m_uiSize) : std::string();
    }

private:
    char* m_pcText = nullptr;
    size_t m_uiSize = 0;
    std::FILE* m_pkFile;
};

} // namespace gw
