#pragma once

#include "ShellOptions.h"

namespace gw {

struct ShellCommand;

/// What came of reading a command line: a command to run, or an exit code where everything is said already.
struct Arguments
{
    const ShellCommand* command = nullptr;
    ShellOptions options;
    EExit exit = EExit::Done; ///< counts where there is no command
};

/// Reads a command line. Help goes to standard output; what is wrong goes to standard error with the nearest
/// right word.
Arguments ParseArguments(int argc, char** argv);

} // namespace gw
