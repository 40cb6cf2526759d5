// A run of many conversions. Workers convert; the program prints, writes reports and keeps the state for
// --resume. Whether a source is up to date is decided by a key: a hash of program version, options, profiles,
// skeleton and source. The steps around saving a result are ordered so that a crash at any point neither
// loses a result nor records one that does not exist; see CResumeState.h.

#include "CFileRun.h"

#include "CContentHash.h"
#include "CFilePlatform.h"
#include "CJsonWriter.h"
#include "CSafeFile.h"
#include "CTextFile.h"
#include "CWorkerPool.h"
#include "CommandTable.h"
#include "Notice.h"
#include "OptionJson.h"
#include "Output.h"
#include "Paths.h"
#include "PrivateNames.h"
#include "Text.h"
#include "Words.h"

#include <algorithm>
#include <charconv>
#include <chrono>
#include <cstring>
#include <new>
#include <numeric>
#include <set>
#include <thread>

#include <sys/wait.h>

namespace gw {

namespace {

constexpr uint8_t kEndsRun = 0x80;
constexpr uint8_t kAbandons = 0x40;
constexpr uint8_t kOutcomeBits = 0x0f;

size_t WorkerCount(const ShellOptions& options, size_t jobCount)
{
    const size_t cores = std::max(1u, std::thread::hardware_concurrency());
    return std::min(options.jobs ? static_cast<size_t>(*options.jobs) : cores, jobCount);
}

// Returns the members of a record that differ between runs; the rest is the same in every run.
std::string RecordHead(const ConversionJob& job)
{
    CTextFile text;
    {
        CJsonWriter json(text.File());
        json.BeginObject();
        json.Key("source").Text(job.source);
        json.Key("output").Text(job.output);
    }
    return text.Text() + ',';
}

// Returns a writer's record, still open at the end, with the job's duration added.
std::string Timed(std::string record, double seconds)
{
    record.resize(std::min(record.size(), record.rfind('}')));
    char digits[64];
    char* const end = std::to_chars(digits, std::end(digits), seconds, std::chars_format::fixed, 4).ptr;
    return record + ",\"seconds\":" + std::string(&digits[0], end);
}

Notice LostNotice(const ConversionJob& job, const JobEnd& end, float limit)
{
    if (end.kind == JobEnd::EKind::TimedOut)
        return MakeNotice(job.source, "time-limit",
                          "not done within " + std::to_string(static_cast<int64_t>(limit)) +
                              " seconds, so it was stopped; use --time-limit to allow more");
    if (end.kind == JobEnd::EKind::Ran)
        return MakeNotice(job.source, "no-record",
                          "the messages about it cannot be stored (is there a limit on the size of "
                          "files?)");
    const std::string cause = WIFSIGNALED(end.status)
                                  ? std::string(strsignal(WTERMSIG(end.status)))
                                  : "exit code " + std::to_string(WEXITSTATUS(end.status));
    return MakeNotice(job.source, "crashed", "the conversion crashed (" + cause + "); nothing was written");
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
    return true;
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
    SayError(Printable(options_.report) + ": the report cannot be written");
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
    const CFilePlatform platform(EPlatformWriting::No, options_.dataFolder);
    CContentHash key;
    key.AddText(GAITWRIGHT_VERSION).AddText(OptionsJson(options_, ~(kHowToRun | kProfile)));
    for (const char* file : {"base.htr", "KsBone.bsm"})
        key.AddFile(platform.DataFolder() + file);
    if (!AddProfiles(key)) // by content, not by name
        return false;
    m_kCommonKey = key.Digits();
    m_kResume.Read(m_kState.folder);
    if (options_.dryRun || m_kResume.Open(m_kState.folder, m_kState.name))
        return true;
    SayError(Printable(m_kState.folder) +
             ": the records of the run cannot be written here, so --resume cannot work");
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
        SayError("no worker process can be started; a smaller --jobs may help");
    if (requests > 0)
        SayError("interrupted");
    const bool isSynced = SyncResults();
    const bool good = TellEnd() && isSynced;
    if (m_bReportFailed)
        SayError(Printable(options_.report) + ": the end of the report cannot be written");
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
        SayError(Printable(failed) +
                 ": the disk reports a failed write; this result or others of the run may be "
                 "damaged");
    const bool isNews = m_kTally[EConversion::Converted] > 0 || m_kResume.HasUnsynced();
    if (isSynced && isNews && options_.resume && !options_.dryRun)
        m_kResume.AddSynced();
    return isSynced;
}

// Called in a worker.

uint8_t CFileRun::Run(size_t index, std::FILE* record)
{
    const ConversionJob& job = m_kJobs[index];
    CSafeFile::DeferSyncs(IsSyncDeferred());
    if (!options_.dryRun)
        CreateFolder(FolderOf(job.output));
    std::string line;
    const FileEnd end = options_.resume ? ConvertResumed(index, line) : ConvertGuarded(options_, index, line);
    Emit(line + "}\n" + Enclosure(), record);
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
        // A folder in the list could not be read; it is reported in place of its files.
        if (FolderExists(m_kJobs[index].source))
            TellLost(index, UnreadableFolder(m_kJobs[index].source), text.File());
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
    if (const std::string* told = m_kResume.FindTold(name, key, digits))
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

// Called in the program.

void CFileRun::Lost(size_t index)
{
    RemoveLeftovers(FolderOf(m_kJobs[index].output));
}

bool CFileRun::Take(size_t index, const JobEnd& end)
{
    m_kBar.Clear();
    Emit(end.words, stderr);
    Emit(end.output, stdout);
    const bool lost = end.kind != JobEnd::EKind::Ran || end.record.find('\n') == end.record.npos;
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
    if (m_kReport.IsOpen() && !m_kReport.AddLine(line))
        m_bReportFailed = true;
}

void CFileRun::Tick(size_t ended)
{
    m_kBar.Show(ended, m_kTally[EConversion::Failed]);
}

} // namespace gw
