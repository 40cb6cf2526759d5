// The parent's side of a worker process: fork, socket, and the collection of its output. A worker writes to
// files in memory rather than pipes, so it can never block on a full pipe, and its last output survives its
// death.

#include "CWorkerProcess.h"

#include "CInterrupt.h"
#include "WorkerMessages.h"

#include <algorithm>
#include <cerrno>
#include <csignal>
#include <thread>
#include <utility>

#include <fcntl.h>
#include <sys/mman.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

namespace gw {

namespace {

using namespace std::chrono_literals;

constexpr auto kPatience = 5s; // to wait for a process that was asked to end
constexpr auto kGlance = 2ms;

void CloseEnd(int& file)
{
    if (file >= 0)
        close(std::exchange(file, -1));
}

// Creates a file in memory, opened for appending, so that writes go to its end even after somebody else has
// emptied it.
int CreateMemory(const char* name)
{
    const int file = memfd_create(name, MFD_CLOEXEC);
    if (file >= 0)
        fcntl(file, F_SETFL, O_APPEND);
    return file;
}

// Removes and returns the text.
std::string TakeText(int file)
{
    struct stat status = {};
    std::string text;
    if (fstat(file, &status) != 0 || status.st_size == 0)
        return text;
    text.resize(static_cast<size_t>(status.st_size));
    const ssize_t count = pread(file, text.data(), text.size(), 0);
    text.resize(static_cast<size_t>(std::max<ssize_t>(count, 0)));
    if (ftruncate(file, 0) != 0)
        text.clear(); // otherwise it would be reported twice
    return text;
}

int WaitFor(pid_t process)
{
    int status = 0;
    while (waitpid(process, &status, 0) < 0 && errno == EINTR)
    {
    }
    return status;
}

} // namespace

std::unique_ptr<CWorkerProcess> CWorkerProcess::Start(CJobHandler& handler, ECommit commit,
                                                      std::span<const int> otherSockets)
{
    std::unique_ptr<CWorkerProcess> worker(new CWorkerProcess);
    int ends[2] = {-1, -1};
    if (!worker->Open() || socketpair(AF_UNIX, SOCK_SEQPACKET | SOCK_CLOEXEC, 0, ends) != 0)
        return nullptr;
    worker->m_iSocket = ends[0];
    std::fflush(nullptr); // otherwise the child would print it again
    worker->m_iProcess = fork();
    if (worker->m_iProcess == 0)
    {
        close(ends[0]);
        for (const int socket : otherSockets)
            close(socket);
        worker->Serve(handler, commit, ends[1]);
    }
    close(ends[1]);
    return worker->m_iProcess > 0 ? std::move(worker) : nullptr;
}

bool CWorkerProcess::Open()
{
    m_iOutput = CreateMemory("output");
    m_iWords = CreateMemory("words");
    m_iRecord = CreateMemory("record");
    return m_iOutput >= 0 && m_iWords >= 0 && m_iRecord >= 0;
}

void CWorkerProcess::Serve(CJobHandler& handler, ECommit commit, int socket)
{
    CInterrupt::Ignore();
    std::FILE* const record = fdopen(m_iRecord, "a");
    if (record && dup2(m_iOutput, STDOUT_FILENO) >= 0 && dup2(m_iWords, STDERR_FILENO) >= 0)
        CWorkerLoop(handler, socket, record, commit).Run();
    _exit(0); // skips the program's own cleanup in the child
}

CWorkerProcess::~CWorkerProcess()
{
    Close();
    const Clock::time_point end = Clock::now() + kPatience;
    while (m_iProcess > 0 && waitpid(m_iProcess, nullptr, WNOHANG) == 0)
    {
        if (Clock::now() > end)
            kill(m_iProcess, SIGKILL);
        std::this_thread::sleep_for(kGlance);
    }
    for (int* file : {&m_iOutput, &m_iWords, &m_iRecord})
        CloseEnd(*file);
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

// If the process is gone, sending fails silently; the next read of its socket shows it.
void CWorkerProcess::Send(size_t job)
{
    const WorkerOrder order{job};
    send(m_iSocket, &order, sizeof order, MSG_NOSIGNAL);
    m_eState = EState::Running;
    m_kSince = Clock::now();
}

bool CWorkerProcess::Receive(JobEnd& end)
{
    WorkerReply reply;
    const ssize_t count = recv(m_iSocket, &reply, sizeof reply, MSG_DONTWAIT);
    if (count < 0 && (errno == EINTR || errno == EAGAIN))
        return false;
    if (count != sizeof reply)
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
    kill(m_iProcess, SIGKILL);
    Bury(end);
    end.kind = JobEnd::EKind::TimedOut;
}

void CWorkerProcess::Bury(JobEnd& end)
{
    end.kind = JobEnd::EKind::Died;
    end.seconds = RunningSeconds();
    end.status = WaitFor(std::exchange(m_iProcess, -1));
    m_eState = EState::Gone;
    Drain(end);
}

void CWorkerProcess::Drain(JobEnd& end)
{
    end.output = TakeText(m_iOutput);
    end.words = TakeText(m_iWords);
    end.record = TakeText(m_iRecord);
}

void CWorkerProcess::Close()
{
    CloseEnd(m_iSocket);
}

} // namespace gw
