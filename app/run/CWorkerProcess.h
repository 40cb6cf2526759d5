#pragma once

#include "CWorkerLoop.h"

#include <memory>
#include <span>

#include <sys/types.h>

namespace gw {

struct WorkerReply;

/// A process that does jobs, as the program sees it. What the process prints goes to files in memory, which
/// outlive it: the last words of one that died are told too.
class CWorkerProcess
{
public:
    enum class EState : uint8_t
    {
        Idle,
        Running,
        Waiting, ///< with a finished result, for its turn
        Gone,
    };

    /// Starts a process. The sockets of those that run already are closed in it, or they would not notice the
    /// end of the program. Null where the system gives none.
    static std::unique_ptr<CWorkerProcess> Start(CJobHandler& handler, ECommit commit,
                                                 std::span<const int> otherSockets);
    /// Waits for the process, which ends by itself when its socket is closed; one that does not within some
    /// seconds is killed.
    ~CWorkerProcess();
    CWorkerProcess(const CWorkerProcess&) = delete;
    CWorkerProcess& operator=(const CWorkerProcess&) = delete;

    EState State() const { return m_eState; }
    size_t Job() const { return m_uiJob; }
    int Socket() const { return m_iSocket; }
    /// Seconds since it was given its job or its turn.
    double RunningSeconds() const;

    void Give(size_t job);
    void LetCommit();
    /// Takes what the process sends: then it waits for its turn, or its job has ended, or it is gone. `end`
    /// is filled when its job has ended; false when it has not.
    bool Receive(JobEnd& end);
    /// Ends the process at once, and its job with it.
    void Kill(JobEnd& end);
    /// Tells the process that there is no more to do. It may still have to end.
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
