#include "CReportFile.h"

#include "CMappedFile.h"
#include "Files.h"
#include "SystemError.h"
#include "Text.h"

#include <utility>

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
        CloseFile(m_iFile);
}

bool CReportFile::Open(const std::string& path, EStart start)
{
    if (m_iFile >= 0)
        CloseFile(std::exchange(m_iFile, -1));
    m_iFile = OpenFile(path, start == EStart::Empty ? EOpen::AppendAnew : EOpen::Append);
    m_bFailed = m_iFile < 0;
    if (m_bFailed)
        KeepSystemError();
    return !m_bFailed && (start == EStart::Empty || !HasOpenLine(path) || AddLine({}));
}

bool CReportFile::HasOpenLine(const std::string& path)
{
    CMappedFile file;
    return file.Open(path) == EFailure::None && !file.Text().empty() && !file.Text().ends_with('\n');
}

bool CReportFile::AddLine(std::string_view line)
{
    m_bFailed = m_bFailed || !WriteAll(m_iFile, std::string(line) + '\n');
    return !m_bFailed;
}

} // namespace gw
