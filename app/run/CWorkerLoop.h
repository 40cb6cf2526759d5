#pragma once

#include "CJobHandler.h"
#include "CWorkerLink.h"

#include <chrono>

namespace gw {

/// When the results of jobs may replace existing files.
enum class ECommit : uint8_t
{
    AtOnce,
    /// after all earlier jobs have succeeded, so that an aborted run leaves what a sequential run would leave
    InTurn,
};

/// The worker's side of the pool: does the jobs it receives until its connection is closed.
class CWorkerLoop
{
public:
    CWorkerLoop(CJobHandler& handler, const CWorkerLink& link, std::FILE* record, ECommit commit);
    void Run();

private:
    using Clock = std::chrono::steady_clock;

    bool MayCommit(const std::string& privatePath);
    bool AskToCommit();

    CJobHandler& handler_;
    CWorkerLink m_kLink;
    std::FILE* m_pkRecord;
    ECommit m_eCommit;
    size_t m_uiJob = 0;
    Clock::duration m_kWaited{};
    bool m_bMayCommit = false; ///< for the rest of this job
};

} // namespace gw
