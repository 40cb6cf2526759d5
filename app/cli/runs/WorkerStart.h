#pragma once

namespace gw {

/// If the program was started as a worker of another one, does its jobs and ends the process. Otherwise
/// returns. Systems that can copy a process start no such workers.
void ServeIfWorker(int argc, char** argv);

} // namespace gw
