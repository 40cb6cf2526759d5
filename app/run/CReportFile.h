#pragma once

#include <string>
#include <string_view>

namespace gw {

/// A text file that grows by whole lines. Each line is written immediately and in one piece, so the file of a
/// killed program contains all lines up to then.
class CReportFile
{
public:
    enum class EStart : bool
    {
        Empty,
        AtEnd, ///< after existing lines; an incomplete last line is ended first
    };

    /// Returns whether a file is empty or starts like a report, with a line about a source and its result.
    /// False if it cannot be read.
    static bool IsReport(const std::string& path);

    CReportFile() = default;
    ~CReportFile();
    CReportFile(const CReportFile&) = delete;
    CReportFile& operator=(const CReportFile&) = delete;

    /// Returns false if the file cannot be written.
    bool Open(const std::string& path, EStart start);
    bool IsOpen() const { return m_iFile >= 0; }
    /// Returns false, now and from then on, if a line cannot be written.
    bool AddLine(std::string_view line);

private:
    static bool HasOpenLine(const std::string& path);

    int m_iFile = -1;
    bool m_bFailed = false;
};

} // namespace gw
