#pragma once

#include "CWorkerLoop.h"
#include "WindowsCalls.h"

#include <chrono>
#include <memory>
#include <span>
#include <string>

namespace gw {

class CWorkerStart;

/// A worker process, as the system sees it: the program, started again, and connected by pipes. Its output
/// goes to temporary files that outlive it. All workers end with the program.
class CWorkerChild
{
public:
    /// Starts a process for a handler. Returns null if the system cannot start one.
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
    /// Waits for the end of the process. Returns its cause, such as "access violation" or "exit code 3".
    std::string Wait();
    /// Closes the connection. The process may take a moment to exit.
    void Close();

    /// Remove and return what the process has written.
    std::string TakeOutput();
    std::string TakeWords();
    std::string TakeRecord();

private:
    CWorkerChild() = default;
    bool Open(CWorkerStart& start);
    bool StartProcess(const CWorkerStart& start);

    CHandle m_kProcess;
    CHandle m_kOrders;
    CHandle m_kReplies;
    CHandle m_kOutput;
    CHandle m_kWords;
    CHandle m_kRecord;
};

} // namespace gw
