#include "Program.h"

#include "Arguments.h"
#include "CommandTable.h"
#include "JsonStatus.h"
#include "LiveNames.h"
#include "StandardStreams.h"
#include "SystemError.h"
#include "Words.h"
#include "WorkerStart.h"

#include <cstdio>
#include <new>

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

} // namespace

int RunProgram(int argc, char** argv)
{
    PrepareStandardStreams();
    ServeIfWorker(argc, argv);
    RemovePrivateFilesOnSignals();
    EExit exit = RunArguments(argc, argv);
    if (IsJsonAsked(argc, argv))
        FinishJson(argv[1], exit);
    ClearLastSystemError();
    if (std::fflush(stdout) != 0 || std::ferror(stdout))
    {
        SayError({}, "write-error",
                 "standard output cannot be written" + SystemErrorWords(LastSystemError()));
        exit = EExit::Failed;
    }
    return static_cast<int>(exit);
}

} // namespace gw
