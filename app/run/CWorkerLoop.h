#pragma once

#include "CJobHandler.h"

#include <chrono>

namespace gw {

/// When the results of jobs may replace existing files.
enum class ECommit : uint8_t
{
    AtOnce,
    /// after all earlier jobs have succeeded, so that an aborted run leaves what a sequential run would leave
    InTurn,
};

/// The worker's side of the pool: does the jobs it receives until its socket is closed.
class CWorkerLoop
{
public:
    CWorkerLoop(CJobHandler& handler, int socket, std::FILE* record, ECommit commit);
    void Run();

private:
    using Clock = std::chrono::steady_clock;

    bool MayCommit(const std::string& privatePath);
    bool AskToCommit();

    CJobHandler& handler_;
    int m_iSocket;
    std::FILE* m_pkRecord;
    ECommit m_eCommit;
    size_t m_uiJob = 0;
    Clock::duration m_kWaited{};
    bool m_bMayCommit = false; ///< for the rest of this job
};

} // namespace gw
