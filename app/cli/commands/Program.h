#pragma once

namespace gw {

/// The whole program: arguments in, the exit code out. 0 done, 1 some work failed, 2 wrong usage.
int RunProgram(int argc, char** argv);

} // namespace gw
