#pragma once

#include "CWorkerProcess.h"

#include <chrono>
#include <map>
#include <optional>
#include <vector>

namespace gw {

class CInterrupt;

struct PoolSettings
{
    size_t workerCount = 1;    ///< processes that work at a time
    double jobSeconds = 600.0; ///< a job that takes longer is given up
    ECommit commit = ECommit::AtOnce;
};

/// Has jobs done by worker processes, each many of them. A job that crashes or hangs costs its process and
/// nothing else: the next one is done by a new process.
class CWorkerPool
{
public:
    /// The handler must outlive the pool.
    CWorkerPool(CJobHandler& handler, const PoolSettings& settings);
    ~CWorkerPool();

    /// Does the jobs below a number. Ends when all have ended, when the handler refuses one, or when an end
    /// is requested: then what is under way is finished first, unless it takes long or the request is
    /// repeated. False when the system gave no process to go on with.
    bool Run(size_t jobCount, const CInterrupt& interrupt);

private:
    using Clock = std::chrono::steady_clock;
    using Workers = std::vector<std::unique_ptr<CWorkerProcess>>;

    size_t CountIn(CWorkerProcess::EState state) const;
    CWorkerProcess* FindIdle();
    CWorkerProcess* StartWorker();
    void GiveJobs(size_t jobCount);
    void OpenGate();
    void Wait() const;
    void ReceiveAll();
    void KillLate();
    void AbandonRunning();
    void ForgetGone();
    void KeepEnd(CWorkerProcess& worker, JobEnd&& end);
    void TakeEnds();
    void TakeRest();
    void Dismiss();

    CJobHandler& handler_;
    PoolSettings m_kSettings;
    Workers m_kWorkers;
    std::map<size_t, JobEnd> m_kEnded;        ///< that wait for an earlier one
    size_t m_uiNext = 0;                      ///< job to be given out
    size_t m_uiTaken = 0;                     ///< number of jobs whose ends were taken, from the first on
    bool m_bRefused = false;                  ///< by the handler
    std::optional<Clock::time_point> ending_; ///< since when the run is to end
};

} // namespace gw
