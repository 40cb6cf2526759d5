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
    size_t workerCount = 1;    ///< number of processes that work at the same time
    double jobSeconds = 600.0; ///< time limit of a job
    ECommit commit = ECommit::AtOnce;
};

/// Runs jobs in worker processes, each of which does many. A job that crashes or hangs only costs its
/// process; the next job gets a new one.
class CWorkerPool
{
public:
    /// The handler must outlive the pool.
    CWorkerPool(CJobHandler& handler, const PoolSettings& settings);
    ~CWorkerPool();

    /// Runs the jobs below a number. Ends when all have ended, when the handler refuses one, or when an
    /// interrupt is requested; running jobs are then finished, unless they take long or the request is
    /// repeated. Returns false if the system could not start a process to continue with.
    bool Run(size_t jobCount, const CInterrupt& interrupt);

private:
    using Clock = std::chrono::steady_clock;
    using Workers = std::vector<std::unique_ptr<CWorkerProcess>>;

    size_t CountIn(CWorkerProcess::EState state) const;
    CWorkerProcess* FindIdle();
    CWorkerProcess* StartWorker();
    void GiveJobs(size_t jobCount);
    void OpenGate();
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
    std::map<size_t, JobEnd> m_kEnded;        ///< waiting for an earlier one
    size_t m_uiNext = 0;                      ///< next job to give out
    size_t m_uiTaken = 0;                     ///< number of jobs whose ends have been delivered
    bool m_bRefused = false;                  ///< the handler ended the run
    std::optional<Clock::time_point> ending_; ///< when the run began to end
};

} // namespace gw
