#include "CWorkerLoop.h"

#include "CSafeFile.h"
#include "WorkerMessages.h"

#include <cerrno>
#include <sys/socket.h>

namespace gw {

namespace {

// Returns false if the program has ended or has no more jobs.
bool Receive(int socket, WorkerOrder& order)
{
    ssize_t count = 0;
    do
        count = recv(socket, &order, sizeof order, 0);
    while (count < 0 && errno == EINTR);
    return count == sizeof order;
}

bool Reply(int socket, const WorkerReply& reply)
{
    return send(socket, &reply, sizeof reply, MSG_NOSIGNAL) == sizeof reply;
}

} // namespace

CWorkerLoop::CWorkerLoop(CJobHandler& handler, int socket, std::FILE* record, ECommit commit)
    : handler_(handler), m_iSocket(socket), m_pkRecord(record), m_eCommit(commit)
{
    CSafeFile::SetCommitGate([this](const std::string& privatePath) { return MayCommit(privatePath); });
}

void CWorkerLoop::Run()
{
    for (WorkerOrder order; Receive(m_iSocket, order);)
    {
        const Clock::time_point start = Clock::now();
        m_kWaited = {};
        m_bMayCommit = m_eCommit == ECommit::AtOnce;
        m_uiJob = order.job;
        const uint8_t answer = handler_.Run(order.job, m_pkRecord);
        const std::chrono::duration<double> worked = Clock::now() - start - m_kWaited;
        std::fflush(nullptr);
        if (!Reply(m_iSocket, {.answer = answer, .seconds = worked.count()}))
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
    m_bMayCommit = Reply(m_iSocket, {.asks = true}) && Receive(m_iSocket, order);
    m_kWaited += Clock::now() - start;
    return m_bMayCommit;
}

} // namespace gw
