#pragma once

#include "Files.h"
#include "Paths.h"

#include <cstdio>
#include <string>

namespace gw {

/// A file that stays in memory unless that is short, for functions that can only write to files.
class CTextFile
{
public:
    CTextFile()
        : m_iFile(OpenNameless(TemporaryFolder())), m_pkFile(m_iFile < 0 ? nullptr : StreamOf(m_iFile, "w+"))
    {
    }
    ~CTextFile()
    {
        if (m_pkFile)
            std::fclose(m_pkFile);
    }
    CTextFile(const CTextFile&) = delete;
    CTextFile& operator=(const CTextFile&) = delete;

    /// Returns the file, or null if it could not be created.
    std::FILE* File() { return m_pkFile; }
    /// Returns the text written so far.
    std::string Text()
    {
        std::string text;
        if (!m_pkFile || std::fseek(m_pkFile, 0, SEEK_END) != 0)
            return text;
        text.resize(static_cast<size_t>(std::ftell(m_pkFile)));
        std::rewind(m_pkFile);
        text.resize(std::fread(text.data(), 1, text.size(), m_pkFile));
        std::fseek(m_pkFile, 0, SEEK_END);
        return text;
    }

private:
    int m_iFile;
    std::FILE* m_pkFile;
};

} // namespace gw
