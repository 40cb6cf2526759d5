#pragma once

#include "CDeferredSync.h"
#include "CInterrupt.h"
#include "CJobHandler.h"
#include "CProgressBar.h"
#include "CReportFile.h"
#include "CResumeState.h"
#include "RunTally.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace gw {

class CContentHash;
struct CReport;

/// Where a run keeps what the next one is to know.
struct RunState
{
    std::string folder;       ///< with its separator at the end, or empty for the present one
    std::string name = "run"; ///< of several runs into one folder each has its own
};

/// Many conversions by worker processes. What is told of them and written about them comes in the order of
/// the sources, whichever was done first. What a file is converted to, and when a failure ends the run, is
/// for the classes below to say.
class CFileRun : public CJobHandler
{
public:
    using Jobs = std::vector<ConversionJob>;

    /// The options must outlive the run.
    CFileRun(const ShellOptions& options, Jobs jobs, RunState state);
    ~CFileRun() override;

    /// Converts all. Says why where it cannot begin, and what is left.
    EExit RunAll();
    const RunTally& Tally() const { return m_kTally; }

    uint8_t Run(size_t job, std::FILE* record) final;
    void Ready(size_t job, const std::string& privatePath) final;
    void Lost(size_t job) final;
    bool Take(size_t job, const JobEnd& end) final;
    void Tick(size_t ended) final;

protected:
    /// How a conversion ended, in a worker; goes to the program as a number.
    struct FileEnd
    {
        EConversion outcome = EConversion::Failed;
        bool endsRun = false;  ///< as the rules of the command say
        bool abandons = false; ///< and it goes without closing words
    };

    /// Converts one source, in a worker.
    virtual FileEnd Convert(const ShellOptions& options, size_t index, std::FILE* record) = 0;
    /// Tells a failure that the conversion could not tell itself. In a worker, or in the program.
    virtual void TellLost(size_t index, const CReport& reason, std::FILE* record) = 0;
    /// Tells that an output stands as an earlier run made it. In a worker.
    virtual void TellUpToDate(size_t index) = 0;
    /// What a conversion hands to the program beside its record. In a worker, behind Convert.
    virtual std::string Enclosure() { return {}; }
    /// What was written about a source in its record, in order, and what was enclosed with it.
    virtual void TakeRecord(size_t, EConversion, std::string_view, std::string_view) {}
    /// Adds to the key of all results the profiles that they may be made by. False, and says why, for none.
    virtual bool AddProfiles(CContentHash& key) = 0;
    /// Closing words. Whether all was well.
    virtual bool TellEnd() = 0;

    const ShellOptions& Options() const { return options_; }
    const Jobs& AllJobs() const { return m_kJobs; }
    bool IsAbandoned() const { return m_bAbandoned; }

private:
    bool Open();
    bool OpenReport();
    std::optional<CReport> WhyNotReport() const;
    bool OpenState();
    bool IsSyncDeferred() const { return m_kJobs.size() > 1; }
    bool SyncResults();
    void SweepLeftovers() const;
    EExit Finish(bool ran, int requests);
    FileEnd ConvertGuarded(const ShellOptions& options, size_t index, std::string& line);
    FileEnd ConvertResumed(size_t index, std::string& line);
    FileEnd KeepChanged(size_t index, std::string& line);
    std::string KeyOf(const ConversionJob& job) const;
    std::string NameInState(const ConversionJob& job) const;
    std::string TakeLost(size_t index, const JobEnd& end);
    void AddToReport(std::string_view line);

    const ShellOptions& options_;
    Jobs m_kJobs;
    RunState m_kState;
    CResumeState m_kResume;
    std::string m_kCommonKey;     ///< of everything but the source
    std::string m_kReadyDigits;   ///< of the job's result, in a worker
    std::string m_kReadyModified; ///< and when it was written
    CReportFile m_kReport;
    CDeferredSync m_kSync;
    CProgressBar m_kBar;
    RunTally m_kTally;
    bool m_bAbandoned = false;
    bool m_bReportFailed = false;
};

} // namespace gw
