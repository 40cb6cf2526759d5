#include "Program.h"

#include "Arguments.h"
#include "Commands.h"
#include "Words.h"

#include <csignal>
#include <cstdio>
#include <new>

namespace gw {

namespace {

// Readers and writers bound what they take by the size of the file, so that only a machine that has less gets
// here.
EExit RunArguments(int argc, char** argv)
{
    try
    {
        const CArguments arguments = ParseArguments(argc, argv);
        return arguments.command ? arguments.command->run(arguments.options) : arguments.exit;
    } catch (const std::bad_alloc&)
    {
        SayError("there is not enough memory for this");
        return EExit::Failed;
    }
}

} // namespace

int RunProgram(int argc, char** argv)
{
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
