#include "CWorkerLoop.h"

#include "CSafeFile.h"

namespace gw {

CWorkerLoop::CWorkerLoop(CJobHandler& handler, const CWorkerLink& link, std::FILE* record, ECommit commit)
    : handler_(handler), m_kLink(link), m_pkRecord(record), m_eCommit(commit)
{
    CSafeFile::SetCommitGate([this](const std::string& privatePath) { return MayCommit(privatePath); });
}

void CWorkerLoop::Run()
{
    for (WorkerOrder order; m_kLink.Receive(order);)
    {
        const Clock::time_point start = Clock::now();
        m_kWaited = {};
        m_bMayCommit = m_eCommit == ECommit::AtOnce;
        m_uiJob = order.job;
        const uint8_t answer = handler_.Run(order.job, m_pkRecord);
        const std::chrono::duration<double> worked = Clock::now() - start - m_kWaited;
        std::fflush(nullptr);
        if (!m_kLink.Reply({.answer = answer, .seconds = worked.count()}))
            return;
    }
}

bool CWorkerLoop::MayCommit(const std::string& privatePath)
{
    if (!m_bMayCommit && !AskToCommit())
        return false;
    handler_.Ready(m_uiJob, privatePath);
    return true;
}

bool CWorkerLoop::AskToCommit()
{
    const Clock::time_point start = Clock::now();
    WorkerOrder order;
    m_bMayCommit = m_kLink.Reply({.asks = true}) && m_kLink.Receive(order);
    m_kWaited += Clock::now() - start;
    return m_bMayCommit;
}

} // namespace gw
