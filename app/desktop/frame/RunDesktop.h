#pragma once

namespace gw {

/// Runs the desktop program and returns its exit code.
int RunDesktop(int argc, char** argv);

} // namespace gw
