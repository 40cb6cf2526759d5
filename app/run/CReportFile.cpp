#include "CReportFile.h"

#include "CMappedFile.h"
#include "SystemError.h"
#include "Text.h"

#include <cerrno>
#include <utility>

#include <fcntl.h>
#include <unistd.h>

namespace gw {

// Plans, states and the output of other commands with --json are JSON lines too.
bool CReportFile::IsReport(const std::string& path)
{
    CMappedFile file;
    if (file.Open(path) != EFailure::None)
        return false;
    std::string_view rest = file.Text();
    std::string_view line;
    return !NextLine(rest, line) ||
           (line.starts_with(R"({"source":")") && line.find(R"(,"outcome":")") != line.npos);
}

CReportFile::~CReportFile()
{
    if (m_iFile >= 0)
        close(m_iFile);
}

bool CReportFile::Open(const std::string& path, EStart start)
{
    if (m_iFile >= 0)
        close(std::exchange(m_iFile, -1));
    // Readable too, to check how the file ends.
    const int cut = start == EStart::Empty ? O_TRUNC : 0;
    m_iFile = open(path.c_str(), O_RDWR | O_CREAT | O_APPEND | O_CLOEXEC | cut, 0666);
    m_bFailed = m_iFile < 0;
    if (m_bFailed)
        KeepSystemError();
    return !m_bFailed && (!HasOpenLine() || AddLine({}));
}

bool CReportFile::HasOpenLine() const
{
    const off_t size = lseek(m_iFile, 0, SEEK_END);
    char last = '\n';
    return size > 0 && pread(m_iFile, &last, 1, size - 1) == 1 && last != '\n';
}

bool CReportFile::AddLine(std::string_view line)
{
    const std::string text = std::string(line) + '\n';
    for (std::string_view rest = text; !m_bFailed && !rest.empty();)
    {
        const ssize_t count = write(m_iFile, rest.data(), rest.size());
        if (count > 0)
            rest.remove_prefix(static_cast<size_t>(count));
        else if (errno != EINTR)
        {
            KeepSystemError();
            m_bFailed = true;
        }
    }
    return !m_bFailed;
}

} // namespace gw
