// Runs jobs in worker processes. Jobs are given out in order to whichever process is free, end in any order,
// and their results are taken in job order.
//
// With ECommit::InTurn, a run that stops at its first failure must leave exactly the files that a sequential
// run would leave, however many processes work ahead. So a worker with a finished result asks before its file
// takes its place, and gets permission when all earlier jobs have succeeded. While it waits it uses no core,
// so another process is started in its place, up to kAhead per active worker.
//
// This cannot deadlock: the earliest unfinished job never waits for another one, and a job that hangs is
// killed after its time limit.

#include "CWorkerPool.h"

#include "CInterrupt.h"

#include <algorithm>
#include <utility>

namespace gw {

namespace {

using EState = CWorkerProcess::EState;

constexpr size_t kAhead = 4;                    // processes per active one, including those that wait
constexpr std::chrono::milliseconds kTick(100); // maximum time between ticks
constexpr std::chrono::seconds kGrace(10);      // for running jobs when the run must end

} // namespace

CWorkerPool::CWorkerPool(CJobHandler& handler, const PoolSettings& settings)
    : handler_(handler), m_kSettings(settings)
{
}

CWorkerPool::~CWorkerPool() = default;

bool CWorkerPool::Run(size_t jobCount, const CInterrupt& interrupt)
{
    for (;;)
    {
        if (!ending_ && (m_bRefused || interrupt.Count() > 0))
            ending_ = Clock::now();
        if (!ending_)
            GiveJobs(jobCount);
        OpenGate();
        if (CountIn(EState::Running) == 0)
            break;
        CWorkerProcess::WaitForAny(m_kWorkers, kTick);
        ReceiveAll();
        if (ending_ && (interrupt.Count() > 1 || Clock::now() - *ending_ > kGrace))
            AbandonRunning();
        KillLate();
        TakeEnds();
        handler_.Tick(m_uiTaken + m_kEnded.size());
    }
    Dismiss();
    TakeRest();
    return ending_ || m_uiTaken == jobCount;
}

size_t CWorkerPool::CountIn(EState state) const
{
    return static_cast<size_t>(
        std::ranges::count_if(m_kWorkers, [=](const auto& worker) { return worker->State() == state; }));
}

CWorkerProcess* CWorkerPool::FindIdle()
{
    const auto isIdle = [](const auto& worker) { return worker->State() == EState::Idle; };
    const auto found = std::ranges::find_if(m_kWorkers, isIdle);
    return found == m_kWorkers.end() ? nullptr : found->get();
}

CWorkerProcess* CWorkerPool::StartWorker()
{
    const size_t limit = m_kSettings.workerCount * (m_kSettings.commit == ECommit::InTurn ? kAhead : 1);
    if (m_kWorkers.size() >= limit)
        return nullptr;
    std::unique_ptr<CWorkerProcess> worker = CWorkerProcess::Start(handler_, m_kSettings.commit, m_kWorkers);
    return worker ? m_kWorkers.emplace_back(std::move(worker)).get() : nullptr;
}

void CWorkerPool::GiveJobs(size_t jobCount)
{
    while (m_uiNext < jobCount && CountIn(EState::Running) < m_kSettings.workerCount)
    {
        CWorkerProcess* worker = FindIdle();
        if (!worker)
            worker = StartWorker();
        if (!worker)
            return;
        worker->Give(m_uiNext++);
    }
}

// The worker whose turn it is; from here on, its result does not depend on any other.
void CWorkerPool::OpenGate()
{
    for (const auto& worker : m_kWorkers)
    {
        if (!m_bRefused && worker->State() == EState::Waiting && worker->Job() == m_uiTaken)
            worker->LetCommit();
    }
}

void CWorkerPool::ReceiveAll()
{
    for (const auto& worker : m_kWorkers)
    {
        JobEnd end;
        if (worker->Receive(end))
            KeepEnd(*worker, std::move(end));
    }
    ForgetGone();
}

void CWorkerPool::KillLate()
{
    for (const auto& worker : m_kWorkers)
    {
        if (worker->State() != EState::Running || worker->RunningSeconds() < m_kSettings.jobSeconds)
            continue;
        JobEnd end;
        worker->Kill(end);
        KeepEnd(*worker, std::move(end));
    }
    ForgetGone();
}

// Their jobs count as not started.
void CWorkerPool::AbandonRunning()
{
    for (const auto& worker : m_kWorkers)
    {
        if (worker->State() != EState::Running)
            continue;
        JobEnd end;
        worker->Kill(end);
        handler_.Lost(worker->Job());
    }
    ForgetGone();
}

void CWorkerPool::KeepEnd(CWorkerProcess& worker, JobEnd&& end)
{
    if (worker.State() == EState::Gone)
        handler_.Lost(worker.Job());
    m_kEnded.emplace(worker.Job(), std::move(end));
}

void CWorkerPool::ForgetGone()
{
    std::erase_if(m_kWorkers, [](const auto& worker) { return worker->State() == EState::Gone; });
}

void CWorkerPool::TakeEnds()
{
    while (!m_bRefused && !m_kEnded.empty() && m_kEnded.begin()->first == m_uiTaken)
    {
        const auto first = m_kEnded.extract(m_kEnded.begin());
        m_bRefused = !handler_.Take(m_uiTaken++, first.mapped());
    }
}

// Takes the ends of jobs after an abandoned one.
void CWorkerPool::TakeRest()
{
    for (auto end = m_kEnded.begin(); !m_bRefused && end != m_kEnded.end(); ++end)
        m_bRefused = !handler_.Take(end->first, end->second);
}

// Closes all processes before waiting for any.
void CWorkerPool::Dismiss()
{
    for (const auto& worker : m_kWorkers)
        worker->Close();
    m_kWorkers.clear();
}

} // namespace gw
