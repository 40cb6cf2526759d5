#pragma once

#include <cstdint>

namespace gw {

/// From the program to a worker: do this job, or, to a worker that asks, you may replace its file. A closed
/// socket means no, and no further job.
struct WorkerOrder
{
    uint64_t job = 0;
};

/// From a worker to the program.
struct WorkerReply
{
    bool asks = false; ///< whether it may replace a file; else the job is done
    uint8_t answer = 0;
    double seconds = 0.0;
};

} // namespace gw
