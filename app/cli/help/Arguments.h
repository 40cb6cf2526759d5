#pragma once

#include "COptions.h"

namespace gw {

struct CCommand;

/// What came of reading a command line: a command to run, or an exit code where everything is said already.
struct CArguments
{
    const CCommand* command = nullptr;
    COptions options;
    EExit exit = EExit::Done; ///< counts where there is no command
};

/// Reads a command line. Help goes to standard output; what is wrong goes to standard error with the nearest
/// right word.
CArguments ParseArguments(int argc, char** argv);

} // namespace gw
