#pragma once

#include <string>
#include <string_view>

namespace gw {

/// A text file that grows by whole lines. Each goes out at once and in one piece, so that the file of a
/// program that was killed holds all lines up to then.
class CReportFile
{
public:
    enum class EStart : bool
    {
        Empty,
        AtEnd, ///< behind what is there; half a line of a writer that died is closed first
    };

    /// Whether a file is empty or begins as a report does: with a line about a source and what became of it.
    /// False for a file that cannot be read.
    static bool IsReport(const std::string& path);

    CReportFile() = default;
    ~CReportFile();
    CReportFile(const CReportFile&) = delete;
    CReportFile& operator=(const CReportFile&) = delete;

    /// False when the file cannot be written.
    bool Open(const std::string& path, EStart start);
    bool IsOpen() const { return m_iFile >= 0; }
    /// False, now and from then on, when the file system does not take it.
    bool AddLine(std::string_view line);

private:
    bool HasOpenLine() const;

    int m_iFile = -1;
    bool m_bFailed = false;
};

} // namespace gw
