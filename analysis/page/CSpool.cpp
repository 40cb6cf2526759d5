#include "CSpool.h"

#include "CSafeFile.h"
#include "Files.h"
#include "Paths.h"
#include "SystemError.h"

#include <array>
#include <string>

namespace gw {

namespace {

// std::tmpfile ignores TMPDIR.
std::FILE* OpenStreamWithoutName()
{
    const std::string folder = TemporaryFolder();
    if (folder.empty())
        return nullptr;
    const int file = OpenNameless(folder);
    std::FILE* const stream = file < 0 ? nullptr : StreamOf(file, "w+");
    if (!stream)
        KeepSystemError();
    if (!stream && file >= 0)
        CloseFile(file);
    return stream;
}

} // namespace

CSpool::CSpool() : m_pkFile(OpenStreamWithoutName()), m_iError(TakeSystemError()) {}

CSpool::~CSpool()
{
    if (m_pkFile)
        std::fclose(m_pkFile);
}

void CSpool::Write(std::string_view text)
{
    // A failure is kept in the stream's error flag.
    if (m_pkFile && std::fwrite(text.data(), 1, text.size(), m_pkFile) != text.size())
        m_iError = LastSystemError();
}

bool CSpool::CopyTo(CSafeFile& file)
{
    if (m_pkFile && m_iError == 0 && std::fflush(m_pkFile) != 0)
        m_iError = LastSystemError();
    if (!m_pkFile || m_iError != 0 || std::ferror(m_pkFile))
    {
        KeepSystemError(m_iError);
        return false;
    }
    std::rewind(m_pkFile); // clears the flag
    std::array<char, size_t{1} << 16> buffer;
    while (const size_t count = std::fread(buffer.data(), 1, buffer.size(), m_pkFile))
    {
        if (!file.Write(std::string_view(buffer.data(), count)))
            return false;
    }
    return !std::ferror(m_pkFile);
}

} // namespace gw
