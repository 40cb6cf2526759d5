#include "Program.h"

#include "Arguments.h"
#include "CommandTable.h"
#include "LiveNames.h"
#include "Words.h"

#include <cerrno>
#include <csignal>
#include <cstdio>
#include <new>

#include <fcntl.h>
#include <unistd.h>

namespace gw {

namespace {

// Readers and writers bound what they take by the size of the file, so that only a machine that has less gets
// here.
EExit RunArguments(int argc, char** argv)
{
    try
    {
        const Arguments arguments = ParseArguments(argc, argv);
        return arguments.command ? arguments.command->run(arguments.options) : arguments.exit;
    } catch (const std::bad_alloc&)
    {
        SayError("there is not enough memory");
        return EExit::Failed;
    }
}

// A stream that whoever started the program has closed leaves its number to the next file that is opened,
// which would then be a result with messages in it.
void OpenStandardStreams()
{
    for (const int stream : {STDIN_FILENO, STDOUT_FILENO, STDERR_FILENO})
    {
        if (fcntl(stream, F_GETFD) < 0 && errno == EBADF)
            open("/dev/null", O_RDWR); // takes the lowest number, which is this one
    }
}

} // namespace

int RunProgram(int argc, char** argv)
{
    OpenStandardStreams();
    RemovePrivateFilesOnSignals();
#ifdef SIGXFSZ
    // A file size limit answers the write with an error, as a full disk does; by itself it would end the
    // program and leave half a file.
    std::signal(SIGXFSZ, SIG_IGN);
#endif
    EExit exit = RunArguments(argc, argv);
    if (std::fflush(stdout) != 0 || std::ferror(stdout))
    {
        SayError("standard output cannot be written");
        exit = EExit::Failed;
    }
    return static_cast<int>(exit);
}

} // namespace gw
