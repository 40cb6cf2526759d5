#pragma once

#include <cstdint>

namespace gw {

/// Sent to a worker: do this job or, if the worker has asked, replace its file. A closed connection means no,
/// and no further jobs.
struct WorkerOrder
{
    uint64_t job = 0;
};

/// Sent by a worker.
struct WorkerReply
{
    bool asks = false; ///< asks to replace a file; otherwise the job is done
    uint8_t answer = 0;
    double seconds = 0.0;
};

} // namespace gw
