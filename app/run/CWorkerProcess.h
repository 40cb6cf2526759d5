#pragma once

#include "CWorkerLoop.h"

#include <memory>
#include <span>

#include <sys/types.h>

namespace gw {

struct WorkerReply;

/// A worker process, seen from the program. Its output goes to files in memory that outlive it, so the last
/// output of a process that died is reported too.
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

    /// Starts a process. Closes the sockets of the other workers in it; otherwise they would not notice the
    /// end of the program. Returns null if the system cannot start one.
    static std::unique_ptr<CWorkerProcess> Start(CJobHandler& handler, ECommit commit,
                                                 std::span<const int> otherSockets);
    /// Waits for the process, which ends when its socket is closed; kills it if that takes more than some
    /// seconds.
    ~CWorkerProcess();
    CWorkerProcess(const CWorkerProcess&) = delete;
    CWorkerProcess& operator=(const CWorkerProcess&) = delete;

    EState State() const { return m_eState; }
    size_t Job() const { return m_uiJob; }
    int Socket() const { return m_iSocket; }
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
    CWorkerProcess() = default;
    bool Open();
    [[noreturn]] void Serve(CJobHandler& handler, ECommit commit, int socket);
    void Send(size_t job);
    void Bury(JobEnd& end);
    void Drain(JobEnd& end);

    using Clock = std::chrono::steady_clock;

    pid_t m_iProcess = -1;
    int m_iSocket = -1;
    int m_iOutput = -1;
    int m_iWords = -1;
    int m_iRecord = -1;
    size_t m_uiJob = 0;
    EState m_eState = EState::Idle;
    Clock::time_point m_kSince;
};

} // namespace gw
