#include "CSpool.h"

#include "CSafeFile.h"

#include <array>
#include <cstdlib>
#include <filesystem>
#include <string>
#include <system_error>

#include <fcntl.h>
#include <unistd.h>

namespace gw {

namespace {

// std::tmpfile ignores TMPDIR.
std::FILE* OpenNameless()
{
    std::error_code error;
    std::string path = (std::filesystem::temp_directory_path(error) / "gaitwright-XXXXXX").string();
    const int file = error ? -1 : mkostemp(path.data(), O_CLOEXEC);
    if (file < 0)
        return nullptr;
    unlink(path.c_str());
    std::FILE* const stream = fdopen(file, "w+");
    if (!stream)
        close(file);
    return stream;
}

} // namespace

CSpool::CSpool() : m_pkFile(OpenNameless()) {}

CSpool::~CSpool()
{
    if (m_pkFile)
        std::fclose(m_pkFile);
}

void CSpool::Write(std::string_view text)
{
    if (m_pkFile)
        std::fwrite(text.data(), 1, text.size(), m_pkFile); // a failure is kept in the stream's error flag
}

bool CSpool::CopyTo(CSafeFile& file)
{
    if (!m_pkFile || std::fflush(m_pkFile) != 0 || std::ferror(m_pkFile))
        return false;
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
