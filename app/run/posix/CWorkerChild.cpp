// The program's side of a worker process: fork, socket, and the collection of its output. A worker writes to
// files in memory rather than pipes, so it can never block on a full pipe, and its last output survives its
// death.

#include "CWorkerChild.h"

#include "CInterrupt.h"

#include <algorithm>
#include <cerrno>
#include <csignal>
#include <cstdio>
#include <cstring>
#include <thread>
#include <utility>
#include <vector>

#include <fcntl.h>
#include <poll.h>
#include <sys/mman.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

namespace gw {

namespace {

using namespace std::chrono_literals;

using Clock = std::chrono::steady_clock;

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

} // namespace

std::unique_ptr<CWorkerChild> CWorkerChild::Start(CJobHandler& handler, ECommit commit,
                                                  std::span<CWorkerChild* const> others)
{
    std::unique_ptr<CWorkerChild> child(new CWorkerChild);
    int ends[2] = {-1, -1};
    if (!child->Open() || socketpair(AF_UNIX, SOCK_SEQPACKET | SOCK_CLOEXEC, 0, ends) != 0)
        return nullptr;
    child->m_iSocket = ends[0];
    std::fflush(nullptr); // otherwise the child would print it again
    child->m_iProcess = fork();
    if (child->m_iProcess == 0)
    {
        close(ends[0]);
        for (const CWorkerChild* other : others)
            close(other->m_iSocket);
        child->Serve(handler, commit, ends[1]);
    }
    close(ends[1]);
    return child->m_iProcess > 0 ? std::move(child) : nullptr;
}

bool CWorkerChild::Open()
{
    m_iOutput = CreateMemory("output");
    m_iWords = CreateMemory("words");
    m_iRecord = CreateMemory("record");
    return m_iOutput >= 0 && m_iWords >= 0 && m_iRecord >= 0;
}

void CWorkerChild::Serve(CJobHandler& handler, ECommit commit, int socket)
{
    CInterrupt::Ignore();
    std::FILE* const record = fdopen(m_iRecord, "a");
    if (record && dup2(m_iOutput, STDOUT_FILENO) >= 0 && dup2(m_iWords, STDERR_FILENO) >= 0)
        CWorkerLoop(handler, CWorkerLink(socket), record, commit).Run();
    _exit(0); // skips the program's own cleanup in the child
}

CWorkerChild::~CWorkerChild()
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

void CWorkerChild::WaitForAny(std::span<CWorkerChild* const> children, std::chrono::milliseconds limit)
{
    std::vector<pollfd> sockets;
    for (const CWorkerChild* child : children)
        sockets.push_back({child->m_iSocket, POLLIN, 0});
    poll(sockets.data(), sockets.size(), static_cast<int>(limit.count()));
}

void CWorkerChild::Send(const WorkerOrder& order)
{
    send(m_iSocket, &order, sizeof order, MSG_NOSIGNAL);
}

CWorkerChild::EReceived CWorkerChild::Receive(WorkerReply& reply)
{
    const ssize_t count = recv(m_iSocket, &reply, sizeof reply, MSG_DONTWAIT);
    if (count < 0 && (errno == EINTR || errno == EAGAIN))
        return EReceived::Nothing;
    return count == sizeof reply ? EReceived::Reply : EReceived::End;
}

void CWorkerChild::Kill()
{
    kill(m_iProcess, SIGKILL);
}

std::string CWorkerChild::Wait()
{
    int status = 0;
    while (waitpid(m_iProcess, &status, 0) < 0 && errno == EINTR)
    {
    }
    m_iProcess = -1;
    return WIFSIGNALED(status) ? std::string(strsignal(WTERMSIG(status)))
                               : "exit code " + std::to_string(WEXITSTATUS(status));
}

void CWorkerChild::Close()
{
    CloseEnd(m_iSocket);
}

std::string CWorkerChild::TakeOutput()
{
    return TakeText(m_iOutput);
}

std::string CWorkerChild::TakeWords()
{
    return TakeText(m_iWords);
}

std::string CWorkerChild::TakeRecord()
{
    return TakeText(m_iRecord);
}

} // namespace gw
