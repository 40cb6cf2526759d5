#include "ChildOutput.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <chrono>
#include <csignal>
#include <thread>

#include <fcntl.h>
#include <poll.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

namespace gw {

namespace {

using Clock = std::chrono::steady_clock;

class CFileActions
{
public:
    CFileActions() { posix_spawn_file_actions_init(&m_kActions); }
    ~CFileActions() { posix_spawn_file_actions_destroy(&m_kActions); }
    CFileActions(const CFileActions&) = delete;
    CFileActions& operator=(const CFileActions&) = delete;

    posix_spawn_file_actions_t* Get() { return &m_kActions; }

private:
    posix_spawn_file_actions_t m_kActions;
};

// Starts the program with its output in a pipe, and sets the end that is read. Returns -1 on failure.
pid_t Start(const std::string& program, const std::vector<std::string>& arguments, int& output)
{
    int ends[2] = {-1, -1};
    if (pipe2(ends, O_CLOEXEC) != 0)
        return -1;
    CFileActions actions;
    posix_spawn_file_actions_addopen(actions.Get(), STDIN_FILENO, "/dev/null", O_RDONLY, 0);
    posix_spawn_file_actions_adddup2(actions.Get(), ends[1], STDOUT_FILENO);
    posix_spawn_file_actions_addopen(actions.Get(), STDERR_FILENO, "/dev/null", O_WRONLY, 0);
    posix_spawn_file_actions_addclosefrom_np(actions.Get(), STDERR_FILENO + 1);
    std::vector<char*> texts{const_cast<char*>(program.c_str())};
    for (const std::string& argument : arguments)
        texts.push_back(const_cast<char*>(argument.c_str()));
    texts.push_back(nullptr);
    pid_t process = -1;
    const int error = posix_spawn(&process, program.c_str(), actions.Get(), nullptr, texts.data(), environ);
    close(ends[1]);
    output = ends[0];
    if (error == 0)
        return process;
    close(output);
    return -1;
}

bool WaitForBytes(int file, Clock::time_point end, const std::function<void()>& wait)
{
    constexpr int64_t kNap = 50; // milliseconds
    while (true)
    {
        if (wait)
            wait();
        const auto left = std::chrono::duration_cast<std::chrono::milliseconds>(end - Clock::now()).count();
        pollfd waiting{file, POLLIN, 0};
        const int count = poll(&waiting, 1, static_cast<int>(std::clamp<int64_t>(left, 0, kNap)));
        if (count > 0)
            return true;
        if ((count < 0 && errno != EINTR) || left <= 0)
            return false;
    }
}

// Reads until the program closes its output. Returns Finished at that point.
EChildEnd Collect(int file, const ChildLimits& limits, std::vector<std::byte>& output,
                  const std::function<void()>& wait)
{
    const Clock::time_point end = Clock::now() + std::chrono::duration_cast<Clock::duration>(
                                                     std::chrono::duration<double>(limits.seconds));
    std::array<std::byte, 1 << 16> piece;
    while (WaitForBytes(file, end, wait))
    {
        const ssize_t count = read(file, piece.data(), piece.size());
        if (count == 0)
            return EChildEnd::Finished;
        if (count < 0 && errno != EINTR)
            return EChildEnd::Died;
        if (output.size() + static_cast<size_t>(std::max<ssize_t>(count, 0)) > limits.outputBytes)
            return EChildEnd::TooMuch;
        output.insert(output.end(), piece.begin(), piece.begin() + std::max<ssize_t>(count, 0));
    }
    return EChildEnd::TimedOut;
}

// Waits for the end of a process, and kills it if that takes too long: a program may close its output and
// stay. Returns whether it exited by itself.
bool HasExited(pid_t process)
{
    constexpr auto kPatience = std::chrono::seconds(5);
    constexpr auto kGlance = std::chrono::milliseconds(1);
    const Clock::time_point end = Clock::now() + kPatience;
    int status = 0;
    for (pid_t ended = 0; ended != process;)
    {
        ended = waitpid(process, &status, WNOHANG);
        if (ended < 0 && errno != EINTR)
            return false;
        if (ended == process)
            break;
        if (Clock::now() > end)
            kill(process, SIGKILL);
        std::this_thread::sleep_for(kGlance);
    }
    return WIFEXITED(status);
}

} // namespace

EChildEnd RunChild(const std::string& program, const std::vector<std::string>& arguments,
                   const ChildLimits& limits, std::vector<std::byte>& output,
                   const std::function<void()>& wait)
{
    output.clear();
    int file = -1;
    const pid_t process = Start(program, arguments, file);
    if (process < 0)
        return EChildEnd::Missing;
    EChildEnd end = EChildEnd::Died;
    try
    {
        end = Collect(file, limits, output, wait);
    } catch (...)
    {
        kill(process, SIGKILL);
        close(file);
        HasExited(process);
        throw;
    }
    close(file);
    if (end != EChildEnd::Finished)
        kill(process, SIGKILL);
    const bool hasExited = HasExited(process);
    return end == EChildEnd::Finished && !hasExited ? EChildEnd::Died : end;
}

} // namespace gw
