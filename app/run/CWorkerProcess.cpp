// A worker process with its state and its job.

#include "CWorkerProcess.h"

#include "CWorkerChild.h"

#include <vector>

namespace gw {

std::unique_ptr<CWorkerProcess> CWorkerProcess::Start(CJobHandler& handler, ECommit commit,
                                                      std::span<const std::unique_ptr<CWorkerProcess>> others)
{
    std::unique_ptr<CWorkerProcess> worker(new CWorkerProcess);
    worker->m_spChild = CWorkerChild::Start(handler, commit, ChildrenOf(others));
    return worker->m_spChild ? std::move(worker) : nullptr;
}

CWorkerProcess::CWorkerProcess() = default;

CWorkerProcess::~CWorkerProcess() = default;

std::vector<CWorkerChild*>
CWorkerProcess::ChildrenOf(std::span<const std::unique_ptr<CWorkerProcess>> workers)
{
    std::vector<CWorkerChild*> children;
    for (const auto& worker : workers)
        children.push_back(worker->m_spChild.get());
    return children;
}

void CWorkerProcess::WaitForAny(std::span<const std::unique_ptr<CWorkerProcess>> workers,
                                std::chrono::milliseconds limit)
{
    CWorkerChild::WaitForAny(ChildrenOf(workers), limit);
}

double CWorkerProcess::RunningSeconds() const
{
    return std::chrono::duration<double>(Clock::now() - m_kSince).count();
}

void CWorkerProcess::Give(size_t job)
{
    m_uiJob = job;
    Send(job);
}

void CWorkerProcess::LetCommit()
{
    Send(m_uiJob);
}

void CWorkerProcess::Send(size_t job)
{
    m_spChild->Send({job});
    m_eState = EState::Running;
    m_kSince = Clock::now();
}

bool CWorkerProcess::Receive(JobEnd& end)
{
    WorkerReply reply;
    const CWorkerChild::EReceived received = m_spChild->Receive(reply);
    if (received == CWorkerChild::EReceived::Nothing)
        return false;
    if (received == CWorkerChild::EReceived::End)
    {
        const bool hadJob = m_eState != EState::Idle;
        Bury(end);
        return hadJob;
    }
    m_eState = reply.asks ? EState::Waiting : EState::Idle;
    if (reply.asks)
        return false;
    end.answer = reply.answer;
    end.seconds = reply.seconds;
    Drain(end);
    return true;
}

void CWorkerProcess::Kill(JobEnd& end)
{
    m_spChild->Kill();
    Bury(end);
    end.kind = JobEnd::EKind::TimedOut;
}

void CWorkerProcess::Bury(JobEnd& end)
{
    end.kind = JobEnd::EKind::Died;
    end.seconds = RunningSeconds();
    end.cause = m_spChild->Wait();
    m_eState = EState::Gone;
    Drain(end);
}

void CWorkerProcess::Drain(JobEnd& end)
{
    end.output = m_spChild->TakeOutput();
    end.words = m_spChild->TakeWords();
    end.record = m_spChild->TakeRecord();
}

void CWorkerProcess::Close()
{
    m_spChild->Close();
}

} // namespace gw
