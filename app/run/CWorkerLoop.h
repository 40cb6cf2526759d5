#pragma once

#include "CJobHandler.h"

#include <chrono>

namespace gw {

/// When the results of jobs may take the place of what was there.
enum class ECommit : uint8_t
{
    AtOnce,
    InTurn, ///< when all earlier jobs have ended well, so that a run that ends leaves what one by one leaves
};

/// A worker's side of the pool: does the jobs that it is given until its socket is closed.
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
    bool m_bMayCommit = false; ///< this job, from here on
};

} // namespace gw
