#pragma once

#include "CWorkerLoop.h"

#include <chrono>
#include <memory>
#include <span>
#include <vector>

namespace gw {

class CWorkerChild;

/// A worker process, seen from the program. Its output goes to files that outlive it, so the last output of a
/// process that died is reported too.
class CWorkerProcess
{
public:
    enum class EState : uint8_t
    {
        Idle,
        Running,
        Waiting, ///< waiting for its turn, with a finished result
        Gone,
    };

    /// Starts a process next to others. Returns null if the system cannot start one.
    static std::unique_ptr<CWorkerProcess> Start(CJobHandler& handler, ECommit commit,
                                                 std::span<const std::unique_ptr<CWorkerProcess>> others);
    /// Waits for the process, which ends when it is closed; kills it if that takes more than some seconds.
    ~CWorkerProcess();
    CWorkerProcess(const CWorkerProcess&) = delete;
    CWorkerProcess& operator=(const CWorkerProcess&) = delete;

    /// Waits until one of the processes has something to receive, at most for some time.
    static void WaitForAny(std::span<const std::unique_ptr<CWorkerProcess>> workers,
                           std::chrono::milliseconds limit);

    EState State() const { return m_eState; }
    size_t Job() const { return m_uiJob; }
    /// Returns the seconds since it got its job or its turn.
    double RunningSeconds() const;

    void Give(size_t job);
    void LetCommit();
    /// Handles what the process sends: it waits for its turn, its job has ended, or it has died. Returns true
    /// and fills `end` if its job has ended.
    bool Receive(JobEnd& end);
    /// Kills the process and ends its job.
    void Kill(JobEnd& end);
    /// Closes the process's job queue. The process may take a moment to exit.
    void Close();

private:
    CWorkerProcess();
    static std::vector<CWorkerChild*> ChildrenOf(std::span<const std::unique_ptr<CWorkerProcess>> workers);
    void Send(size_t job);
    void Bury(JobEnd& end);
    void Drain(JobEnd& end);

    using Clock = std::chrono::steady_clock;

    std::unique_ptr<CWorkerChild> m_spChild;
    size_t m_uiJob = 0;
    EState m_eState = EState::Idle;
    Clock::time_point m_kSince;
};

} // namespace gw
