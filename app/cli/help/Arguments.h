#pragma once

#include "ShellOptions.h"

namespace gw {

struct ShellCommand;

/// The result of parsing a command line: a command to run, or the exit code if nothing is left to do.
struct Arguments
{
    const ShellCommand* command = nullptr;
    ShellOptions options;
    EExit exit = EExit::Done; ///< the exit code if no command is to run
};

/// Parses a command line. Help goes to standard output; errors go to standard error, with the most similar
/// valid word.
Arguments ParseArguments(int argc, char** argv);

} // namespace gw
