#include "StandardStreams.h"

#include <algorithm>
#include <cerrno>
#include <csignal>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace gw {

namespace {

// Redirected to a file, these are links to it. The file belongs to the shell that opened it, and must not be
// replaced by another one.
constexpr std::string_view kDescriptors[] = {"/dev/fd/", "/proc/self/fd/", "/dev/stdin", "/dev/stdout",
                                             "/dev/stderr"};

} // namespace

void PrepareStandardStreams()
{
    for (const int stream : {STDIN_FILENO, STDOUT_FILENO, STDERR_FILENO})
    {
        if (fcntl(stream, F_GETFD) < 0 && errno == EBADF)
            open("/dev/null", O_RDWR); // gets the lowest free number, which is this stream's
    }
    // With the signal ignored, exceeding a file size limit fails the write like a full disk; otherwise it
    // would end the program and leave half a file.
    std::signal(SIGXFSZ, SIG_IGN);
}

bool IsStreamPath(const std::string& path)
{
    if (std::ranges::any_of(kDescriptors, [&](std::string_view name) { return path.starts_with(name); }))
        return true;
    struct stat status;
    return stat(path.c_str(), &status) == 0 && !S_ISREG(status.st_mode) && !S_ISDIR(status.st_mode);
}

bool IsStandardOutputPath(const std::string& path)
{
    return path == "/dev/stdout" || path == "/dev/fd/1" || path == "/proc/self/fd/1";
}

std::string_view ForbiddenInFileNames()
{
    return {"/\\\0",
            3}; // the second is allowed, but a file with it in its name cannot be moved to other systems
}

} // namespace gw
