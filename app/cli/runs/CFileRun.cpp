// The program's side of a run of many conversions: it prints, writes reports and keeps the state for
// --resume, while workers convert (CFileRunWorker.cpp). Whether a source is up to date is decided by a key: a
// hash of program version, options, profiles, skeleton and source. The steps around saving a result are
// ordered so that a crash at any point neither loses a result nor records one that does not exist; see
// CResumeState.h.

#include "CFileRun.h"

#include "CContentHash.h"
#include "CSafeFile.h"
#include "CSystemPlatform.h"
#include "CTextFile.h"
#include "CWorkerPool.h"
#include "CommandTable.h"
#include "Notice.h"
#include "OptionJson.h"
#include "Output.h"
#include "Paths.h"
#include "PrivateNames.h"
#include "RunRecord.h"
#include "RunSetup.h"
#include "SystemError.h"
#include "Text.h"
#include "Words.h"

#include <algorithm>
#include <numeric>
#include <set>
#include <thread>

namespace gw {

namespace {

size_t WorkerCount(const ShellOptions& options, size_t jobCount)
{
    const size_t cores = std::max(1u, std::thread::hardware_concurrency());
    return std::min(options.jobs ? static_cast<size_t>(*options.jobs) : cores, jobCount);
}

void Emit(const std::string& text, std::FILE* file)
{
    std::fwrite(text.data(), 1, text.size(), file);
}

} // namespace

CFileRun::CFileRun(const ShellOptions& options, Jobs jobs, RunState state)
    : options_(options), m_kJobs(std::move(jobs)), m_kState(std::move(state)),
      m_kBar(m_kJobs.size(), !options.quiet && !options.json)
{
}

CFileRun::~CFileRun() = default;

EExit CFileRun::RunAll()
{
    if (!Open())
        return EExit::Failed;
    const PoolSettings settings{.workerCount = WorkerCount(options_, m_kJobs.size()),
                                .jobSeconds = options_.timeLimit,
                                .commit = options_.keepGoing ? ECommit::AtOnce : ECommit::InTurn};
    const CInterrupt interrupt;
    const bool ran = CWorkerPool(*this, settings).Run(m_kJobs.size(), interrupt);
    m_kBar.Clear();
    return Finish(ran, interrupt.Count());
}

bool CFileRun::Open()
{
    if (options_.resume && !OpenState())
        return false;
    if (!options_.dryRun && !OpenReport()) // last, because it truncates an existing report
        return false;
    if (!options_.dryRun)
        SweepLeftovers();
    if (options_.draft)
        m_kDrafts.emplace(DraftFolder(), m_kJobs.size());
    return true;
}

// A resumed run needs the drafts of the runs before it. A dry run keeps none.
std::string CFileRun::DraftFolder() const
{
    if (options_.dryRun)
        return {};
    return options_.drafts.empty() && options_.resume ? ResumeDrafts(m_kState.folder) : options_.drafts;
}

bool CFileRun::OpenReport()
{
    if (options_.report.empty())
        return true;
    if (const std::optional<Notice> refusal = WhyNotReport())
    {
        SayNotice(options_, *refusal);
        return false;
    }
    if (m_kReport.Open(options_.report, CReportFile::EStart::Empty))
        return true;
    SayError(options_.report, "write-error", "the report cannot be written" + TakeSystemErrorWords());
    return false;
}

std::optional<Notice> CFileRun::WhyNotReport() const
{
    const std::string& path = options_.report;
    const auto isReport = [&](const std::string& other) { return IsSameFile(path, other); };
    if (std::ranges::any_of(m_kJobs, isReport, &ConversionJob::source) ||
        std::ranges::any_of(m_kJobs, isReport, &ConversionJob::output) || isReport(options_.filesFrom) ||
        isReport(options_.html) || isReport(options_.profile))
        return MakeNotice(path, "in-use",
                          "the run reads or writes this file; choose another file for the report");
    if (options_.resume && CReportFile::IsReport(path))
        return std::nullopt; // another message would repeat the first one
    return WhyNotWrite(options_, path);
}

bool CFileRun::OpenState()
{
    const CSystemPlatform platform(EPlatformWriting::No, options_.dataFolder);
    CContentHash key;
    constexpr uint64_t kHowToTell = kCheck | kHtml; // figures are stored in any case
    key.AddText(GAITWRIGHT_VERSION)
        .AddText(OptionsJson(options_, ~(kHowToRun | kHowToTell | kProfile | kDrafts)));
    for (const char* file : {"base.htr", "KsBone.bsm"})
        key.AddFile(platform.DataFolder() + file);
    if (!AddProfiles(key)) // by content, not by name
        return false;
    m_kCommonKey = key.Digits();
    m_kResume.Read(m_kState.folder);
    if (options_.dryRun || m_kResume.Open(m_kState.folder, m_kState.name))
        return true;
    SayError(m_kState.folder, "write-error",
             "the records of the run cannot be written here, so --resume cannot work" +
                 TakeSystemErrorWords());
    return false;
}

// Deletes files left over by killed runs.
void CFileRun::SweepLeftovers() const
{
    std::set<std::string> folders;
    for (const ConversionJob& job : m_kJobs)
        folders.insert(FolderOf(job.output));
    for (const std::string& folder : folders)
        RemoveLeftovers(folder);
}

EExit CFileRun::Finish(bool ran, int requests)
{
    m_kTally.left = m_kJobs.size() - std::accumulate(m_kTally.ended.begin(), m_kTally.ended.end(), size_t{0});
    if (!ran)
        SayError({}, "no-worker", "no worker process can be started; a smaller --jobs may help");
    if (requests > 0)
        SayError({}, "interrupted", "interrupted");
    const bool isSynced = SyncResults();
    const bool good = TellEnd() && isSynced;
    if (m_bReportFailed)
        SayError(options_.report, "write-error",
                 "the end of the report cannot be written" + SystemErrorWords(m_iReportError));
    if (requests > 0)
        return EExit::Interrupted;
    return good && ran && !m_bReportFailed ? EExit::Done : EExit::Failed;
}

// Called before anything reports the run as done. In a run of one file, the result has already been synced.
bool CFileRun::SyncResults()
{
    if (options_.resume && m_kResume.HasUnsynced())
        m_kSync.Add(m_kState.folder.empty() ? "." : m_kState.folder);
    const std::string failed = m_kSync.Sync();
    const bool isSynced = failed.empty();
    if (!isSynced)
        SayError(failed, "write-error",
                 "the disk reports a failed write" + TakeSystemErrorWords() +
                     "; this result or others of the run may be damaged");
    const bool isNews = m_kTally[EConversion::Converted] > 0 || m_kResume.HasUnsynced();
    if (isSynced && isNews && options_.resume && !options_.dryRun)
        m_kResume.AddSynced();
    return isSynced;
}

void CFileRun::Lost(size_t index)
{
    if (m_kDrafts)
        m_kDrafts->Settle(index);
    RemoveLeftovers(FolderOf(m_kJobs[index].output));
}

bool CFileRun::Take(size_t index, const JobEnd& end)
{
    const bool lost = end.kind != JobEnd::EKind::Ran || end.record.find('\n') == end.record.npos;
    if (lost || !end.words.empty() || !end.output.empty())
        m_kBar.Clear();
    Emit(end.words, stderr);
    Emit(end.output, stdout);
    const std::string record = lost ? TakeLost(index, end) : end.record;
    std::fflush(stdout);
    const auto outcome = lost ? EConversion::Failed : static_cast<EConversion>(end.answer & kOutcomeBits);
    ++m_kTally[outcome];
    if (outcome == EConversion::Converted && IsSyncDeferred())
        m_kSync.Add(m_kJobs[index].output);
    m_bAbandoned = m_bAbandoned || (end.answer & kAbandons) != 0;
    std::string_view enclosure = record;
    std::string_view line;
    NextLine(enclosure, line);
    AddToReport(line);
    m_kSummary.Take(m_kJobs[index].source, outcome, line);
    TakeRecord(index, outcome, line, enclosure);
    return lost ? options_.keepGoing : (end.answer & kEndsRun) == 0;
}

std::string CFileRun::TakeLost(size_t index, const JobEnd& end)
{
    CTextFile text;
    TellLost(index, LostNotice(m_kJobs[index], end, options_.timeLimit), text.File());
    return Timed(text.Text(), end.seconds) + "}\n";
}

void CFileRun::AddToReport(std::string_view line)
{
    if (!m_kReport.IsOpen() || m_bReportFailed || m_kReport.AddLine(line))
        return;
    m_bReportFailed = true;
    m_iReportError = TakeSystemError();
}

void CFileRun::Tick(size_t ended)
{
    m_kBar.Show(ended, m_kTally[EConversion::Failed]);
}

} // namespace gw
