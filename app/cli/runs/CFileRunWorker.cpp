// The workers' side of a run of many conversions: each converts one source after another, and answers with a
// line of JSON and an outcome.

#include "CFileRun.h"

#include "CContentHash.h"
#include "CJsonMembers.h"
#include "CSafeFile.h"
#include "CTextFile.h"
#include "Notice.h"
#include "Output.h"
#include "Paths.h"
#include "RunRecord.h"

#include <algorithm>
#include <chrono>
#include <new>

namespace gw {

uint8_t CFileRun::Run(size_t index, std::FILE* record)
{
    const ConversionJob& job = m_kJobs[index];
    CSafeFile::DeferSyncs(IsSyncDeferred());
    if (m_kDrafts)
        m_kDrafts->Begin(index);
    if (!options_.dryRun)
        CreateFolder(FolderOf(job.output));
    std::string line;
    const FileEnd end = options_.resume ? ConvertResumed(index, line) : ConvertGuarded(options_, index, line);
    if (m_kDrafts)
        m_kDrafts->Settle(index);
    const std::string text = line + "}\n" + Enclosure();
    std::fwrite(text.data(), 1, text.size(), record);
    return static_cast<uint8_t>(static_cast<uint8_t>(end.outcome) | (end.endsRun ? kEndsRun : 0) |
                                (end.abandons ? kAbandons : 0));
}

CFileRun::FileEnd CFileRun::ConvertGuarded(const ShellOptions& options, size_t index, std::string& line)
{
    const auto start = std::chrono::steady_clock::now();
    CTextFile text;
    FileEnd end{.endsRun = !options.keepGoing};
    try
    {
        if (const std::optional<Notice> reason = WhyNoSource(m_kJobs[index].source))
            TellLost(index, *reason, text.File());
        else
            end = Convert(options, index, text.File());
    } catch (const std::bad_alloc&)
    {
        TellLost(index, MakeNotice(m_kJobs[index].source, "memory", "there is not enough memory"),
                 text.File());
    }
    const std::chrono::duration<double> seconds = std::chrono::steady_clock::now() - start;
    line = Timed(text.Text(), seconds.count());
    return end;
}

CFileRun::FileEnd CFileRun::ConvertResumed(size_t index, std::string& line)
{
    const ConversionJob& job = m_kJobs[index];
    const std::string name = NameInState(job);
    const std::string key = KeyOf(job);
    const std::string head = RecordHead(job);
    const std::string digits = FileDigits(job.output);
    if (const std::string* told = m_kResume.FindTold(name, key, digits); told && IsDraftSame(*told))
    {
        TellUpToDate(index);
        line = head + *told + ",\"resumed\":true";
        return {.outcome = EConversion::Skipped};
    }
    ShellOptions options = options_;
    if (!options.force && m_kResume.Knows(name) && FileExists(job.output))
    {
        if (!m_kResume.IsOwn(name, digits, ModificationDigits(job.output)))
            return KeepChanged(index, line);
        options.force = true;
    }
    const FileEnd end = ConvertGuarded(options, index, line);
    if (end.outcome == EConversion::Converted)
        m_kResume.AddMade(name, key, m_kReadyDigits, m_kReadyModified,
                          line.substr(std::min(head.size(), line.size())));
    return end;
}

// A result becomes outdated when somebody corrects the draft that it was made with.
bool CFileRun::IsDraftSame(const std::string& told) const
{
    CJsonMembers record;
    std::string path;
    std::string digits;
    if (!options_.draft || record.Read('{' + told + '}') != EFailure::None ||
        !record.TakeText("draftDigits", digits) || !record.TakeText("profilePath", path))
        return true;
    const std::string now = FileDigits(path);
    return now.empty() || now == digits;
}

CFileRun::FileEnd CFileRun::KeepChanged(size_t index, std::string& line)
{
    CTextFile text;
    TellLost(index,
             MakeNotice(m_kJobs[index].output, "changed",
                        "this file was changed after the run wrote it, so it was kept; --force replaces it"),
             text.File());
    line = Timed(text.Text(), 0.0);
    return {.endsRun = !options_.keepGoing};
}

void CFileRun::Ready(size_t index, const std::string& privatePath)
{
    if (!options_.resume)
        return;
    m_kReadyDigits = FileDigits(privatePath);
    m_kReadyModified = ModificationDigits(privatePath);
    m_kResume.AddReady(NameInState(m_kJobs[index]), m_kReadyDigits, m_kReadyModified);
}

std::string CFileRun::KeyOf(const ConversionJob& job) const
{
    return CContentHash().AddText(m_kCommonKey).AddText(NameInState(job)).AddFile(job.source).Digits();
}

// Returns a name that does not depend on the current folder.
std::string CFileRun::NameInState(const ConversionJob& job) const
{
    return job.output.starts_with(m_kState.folder) ? job.output.substr(m_kState.folder.size()) : job.output;
}

} // namespace gw
