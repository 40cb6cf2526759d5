#pragma once

#include "CDeferredSync.h"
#include "CDraftShelf.h"
#include "CInterrupt.h"
#include "CJobHandler.h"
#include "CProgressBar.h"
#include "CReportFile.h"
#include "CResumeState.h"
#include "CRunSummary.h"
#include "RunTally.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

class CContentHash;
class CJsonMembers;
struct Notice;

/// Where a run keeps its state for the next run.
struct RunState
{
    std::string folder;       ///< with a trailing separator, or empty for the current folder
    std::string name = "run"; ///< distinguishes several runs in one folder
};

/// Converts many files in worker processes. Messages and records appear in source order, no matter which file
/// finishes first. Derived classes define how a file is converted and when a failure ends the run.
class CFileRun : public CJobHandler
{
public:
    using Jobs = std::vector<ConversionJob>;

    /// The options must outlive the run.
    CFileRun(const ShellOptions& options, Jobs jobs, RunState state);
    ~CFileRun() override;

    /// Converts everything. If it cannot start or finish, prints the reason or the number of files left.
    EExit RunAll();
    const RunTally& Tally() const { return m_kTally; }

    uint8_t Run(size_t job, std::FILE* record) final;
    std::string Description() const final;
    /// Continues a run in a worker that was made from its description; `head` is the first line.
    void BeginInWorker(const CJsonMembers& head);
    void Ready(size_t job, const std::string& privatePath) final;
    void Lost(size_t job) final;
    bool Take(size_t job, const JobEnd& end) final;
    void Tick(size_t ended) final;

protected:
    /// The outcome of a conversion in a worker; sent to the program as a number.
    struct FileEnd
    {
        EConversion outcome = EConversion::Failed;
        bool endsRun = false;  ///< the command's rules end the run here
        bool abandons = false; ///< the run ends without a summary
    };

    /// Converts one source. Called in a worker.
    virtual FileEnd Convert(const ShellOptions& options, size_t index, std::FILE* record) = 0;
    /// Reports a failure that the conversion could not report itself. Called in a worker or in the program.
    virtual void TellLost(size_t index, const Notice& reason, std::FILE* record) = 0;
    /// Reports that an output from an earlier run is up to date. Called in a worker.
    virtual void TellUpToDate(size_t index) = 0;
    /// Returns data for the program in addition to the record. Called in a worker after Convert.
    virtual std::string Enclosure() { return {}; }
    /// Handles a source's record and the data enclosed with it, in source order.
    virtual void TakeRecord(size_t, EConversion, std::string_view, std::string_view) {}
    /// Adds all profiles that may be used to the key of every result. If there are none, prints why and
    /// returns false.
    virtual bool AddProfiles(CContentHash& key) = 0;
    /// Prints the summary. Returns whether everything succeeded.
    virtual bool TellEnd() = 0;

    const ShellOptions& Options() const { return options_; }
    const Jobs& AllJobs() const { return m_kJobs; }
    /// Returns where drafted profiles are kept; null without the option --draft.
    CDraftShelf* Drafts() { return m_kDrafts ? &*m_kDrafts : nullptr; }
    /// Returns what a source prints. Many print nothing, because the summary does, but a failure that ends
    /// the run is printed in full.
    EVoice Voice() const
    {
        if (options_.verbose || m_kJobs.size() == 1)
            return EVoice::Speaks;
        return options_.keepGoing ? EVoice::Silent : EVoice::Failures;
    }
    /// Returns whether a source prints its result.
    bool IsEachTold() const { return Voice() == EVoice::Speaks; }
    /// Prints the summary.
    void TellSummary() const { m_kSummary.Tell(options_, m_kTally, Voice() != EVoice::Silent); }
    bool IsAbandoned() const { return m_bAbandoned; }

private:
    // The answer of a worker: an outcome and two bits.
    static constexpr uint8_t kEndsRun = 0x80;
    static constexpr uint8_t kAbandons = 0x40;
    static constexpr uint8_t kOutcomeBits = 0x0f;

    bool Open();
    bool OpenReport();
    std::optional<Notice> WhyNotReport() const;
    bool OpenState();
    std::string DraftFolder() const;
    bool IsSyncDeferred() const { return m_kJobs.size() > 1; }
    bool SyncResults();
    void SweepLeftovers() const;
    EExit Finish(bool ran, int requests);
    FileEnd ConvertGuarded(const ShellOptions& options, size_t index, std::string& line);
    FileEnd ConvertResumed(size_t index, std::string& line);
    bool IsDraftSame(const std::string& told) const;
    FileEnd KeepChanged(size_t index, std::string& line);
    std::string KeyOf(const ConversionJob& job) const;
    std::string NameInState(const ConversionJob& job) const;
    std::string TakeLost(size_t index, const JobEnd& end);
    void AddToReport(std::string_view line);

    const ShellOptions& options_;
    Jobs m_kJobs;
    RunState m_kState;
    CResumeState m_kResume;
    std::string m_kCommonKey;     ///< covers everything except the source
    std::string m_kReadyDigits;   ///< in a worker: hash of the job's result
    std::string m_kReadyModified; ///< its modification time
    CReportFile m_kReport;
    CDeferredSync m_kSync;
    CProgressBar m_kBar;
    std::optional<CDraftShelf> m_kDrafts;
    CRunSummary m_kSummary;
    RunTally m_kTally;
    bool m_bAbandoned = false;
    bool m_bReportFailed = false;
    int m_iReportError = 0; ///< errno of the failed write
};

} // namespace gw
