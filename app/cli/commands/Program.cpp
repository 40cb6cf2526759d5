#include "Program.h"

#include "Arguments.h"
#include "CommandTable.h"
#include "JsonStatus.h"
#include "LiveNames.h"
#include "SystemError.h"
#include "Words.h"

#include <cerrno>
#include <csignal>
#include <cstdio>
#include <new>

#include <fcntl.h>
#include <unistd.h>

namespace gw {

namespace {

// Readers and writers limit their memory by the file size, so only a machine with less memory gets here.
EExit RunArguments(int argc, char** argv)
{
    try
    {
        const Arguments arguments = ParseArguments(argc, argv);
        return arguments.command ? arguments.command->run(arguments.options) : arguments.exit;
    } catch (const std::bad_alloc&)
    {
        SayError({}, "memory", "there is not enough memory");
        return EExit::Failed;
    }
}

// If the caller has closed a standard stream, the next opened file would get its number, and messages would
// be written into a result.
void OpenStandardStreams()
{
    for (const int stream : {STDIN_FILENO, STDOUT_FILENO, STDERR_FILENO})
    {
        if (fcntl(stream, F_GETFD) < 0 && errno == EBADF)
            open("/dev/null", O_RDWR); // gets the lowest free number, which is this stream's
    }
}

} // namespace

int RunProgram(int argc, char** argv)
{
    OpenStandardStreams();
    RemovePrivateFilesOnSignals();
#ifdef SIGXFSZ
    // With the signal ignored, exceeding a file size limit fails the write like a full disk; otherwise it
    // would end the program and leave half a file.
    std::signal(SIGXFSZ, SIG_IGN);
#endif
    EExit exit = RunArguments(argc, argv);
    if (IsJsonAsked(argc, argv))
        FinishJson(argv[1], exit);
    errno = 0;
    if (std::fflush(stdout) != 0 || std::ferror(stdout))
    {
        SayError({}, "write-error", "standard output cannot be written" + SystemErrorWords(errno));
        exit = EExit::Failed;
    }
    return static_cast<int>(exit);
}

} // namespace gw
