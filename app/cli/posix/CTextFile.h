#pragma once

#include <cstdio>
#include <cstdlib>
#include <string>

namespace gw {

/// A file in memory, for functions that can only write to files.
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

    /// Returns the file, or null if there is not enough memory.
    std::FILE* File() { return m_pkFile; }
    /// Returns the text written so far.
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
