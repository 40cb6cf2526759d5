#include "CMendedSource.h"

#include "CFileExam.h"
#include "FindingWords.h"
#include "Paths.h"

namespace gw {

namespace {

constexpr size_t kNamedFaults = 3; // more would not fit into a line

bool IsMendedFault(const Finding& finding)
{
    return finding.mendable && finding.severity != ESeverity::Note;
}

} // namespace

bool CMendedSource::Mend(const std::string& path)
{
    m_kCopy.Remove();
    m_kPath = path;
    m_kFindings = {};
    if (!HasExtension(path, ".bvh"))
        return true;
    CFileExam exam;
    exam.ExamineBVH(path);
    if (!exam.Findings().MendsAny())
        return true;
    m_kFindings = exam.Findings();
    const bool isWritten = WriteCopy(exam);
    if (!isWritten)
        m_kCopy.Remove();
    return isWritten;
}

// In the folder for temporary files: nothing else may appear next to the user's motions.
bool CMendedSource::WriteCopy(CFileExam& exam)
{
    return m_kCopy.CreateTemporary(".bvh") &&
           exam.WriteMended([&](std::string_view text) { return WriteAll(m_kCopy.File(), text); });
}

std::string CMendedSource::Words() const
{
    std::string words;
    size_t named = 0;
    size_t more = 0;
    for (const Finding& finding : m_kFindings.Sorted())
    {
        if (!IsMendedFault(finding))
            continue;
        if (named == kNamedFaults)
        {
            more += 1 + finding.more;
            continue;
        }
        ++named;
        words += words.empty() ? "" : "; ";
        words += finding.where == 0 ? "" : "line " + std::to_string(finding.where) + ": ";
        words += FindingWords(m_kPath, finding);
    }
    return more == 0 ? words : words + "; and " + std::to_string(more) + " more faults";
}

} // namespace gw
