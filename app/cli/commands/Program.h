#pragma once

namespace gw {

/// Runs the program and returns the exit code: 0 done, 1 some work failed, 2 wrong usage.
int RunProgram(int argc, char** argv);

} // namespace gw
