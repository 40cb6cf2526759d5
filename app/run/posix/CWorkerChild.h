#pragma once

#include "CWorkerLoop.h"

#include <chrono>
#include <memory>
#include <span>
#include <string>

#include <sys/types.h>

namespace gw {

/// A worker process, as the system sees it: a copy of the program that is connected by a socket. Its output
/// goes to files in memory that outlive it.
class CWorkerChild
{
public:
    /// Starts a process for a handler. Closes the sockets of the other workers in it; otherwise they would
    /// not notice the end of the program. Returns null if the system cannot start one.
    static std::unique_ptr<CWorkerChild> Start(CJobHandler& handler, ECommit commit,
                                               std::span<CWorkerChild* const> others);
    /// Waits for the process, which ends when its connection is closed; kills it if that takes more than some
    /// seconds.
    ~CWorkerChild();
    CWorkerChild(const CWorkerChild&) = delete;
    CWorkerChild& operator=(const CWorkerChild&) = delete;

    /// Waits until one of the processes has replied or ended, at most for some time.
    static void WaitForAny(std::span<CWorkerChild* const> children, std::chrono::milliseconds limit);

    /// Sends an order. If the process is gone, this fails silently; the next Receive shows it.
    void Send(const WorkerOrder& order);
    enum class EReceived : uint8_t
    {
        Nothing,
        Reply,
        End, ///< the process has ended
    };
    /// Does not wait.
    EReceived Receive(WorkerReply& reply);
    void Kill();
    /// Waits for the end of the process. Returns its cause, such as "Segmentation fault" or "exit code 3".
    std::string Wait();
    /// Closes the connection. The process may take a moment to exit.
    void Close();

    /// Remove and return what the process has written.
    std::string TakeOutput();
    std::string TakeWords();
    std::string TakeRecord();

private:
    CWorkerChild() = default;
    bool Open();
    [[noreturn]] void Serve(CJobHandler& handler, ECommit commit, int socket);

    pid_t m_iProcess = -1;
    int m_iSocket = -1;
    int m_iOutput = -1;
    int m_iWords = -1;
    int m_iRecord = -1;
};

} // namespace gw
