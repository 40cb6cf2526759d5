#pragma once

namespace gw {

/// The whole desktop program, from its command line to its exit code.
int RunDesktop(int argc, char** argv);

} // namespace gw
