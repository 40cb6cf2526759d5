#pragma once

#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <string>

namespace gw {

/// How a job ended, and its output.
struct JobEnd
{
    enum class EKind : uint8_t
    {
        Ran,      ///< finished; `answer` is its result
        Died,     ///< its process died; `cause` says how
        TimedOut, ///< its process was killed because the job took too long
    };

    EKind kind = EKind::Ran;
    uint8_t answer = 0;
    std::string cause;    ///< such as "Segmentation fault"
    double seconds = 0.0; ///< time spent working, without waiting for its turn
    std::string output;   ///< standard output
    std::string words;    ///< standard error
    std::string record;   ///< content of its record
};

/// Defines the jobs of a pool, which are numbered from 0.
class CJobHandler
{
public:
    virtual ~CJobHandler() = default;

    /// Does a job. Runs in a worker process, so changes in memory stay there. Where the system can, the
    /// process is a copy of the program at the time it was started; elsewhere, its handler was made from
    /// Description. Returns a number of the handler's choice.
    virtual uint8_t Run(size_t job, std::FILE* record) = 0;
    /// Returns a text from which the program makes the same handler in another process, on systems that
    /// cannot copy a process.
    virtual std::string Description() const { return {}; }
    /// Called before a job's result, complete under a private path, takes its place. Runs in the worker.
    virtual void Ready(size_t, const std::string&) {}
    /// Called immediately when a job's process has ended; nobody is working on it any more.
    virtual void Lost(size_t) {}
    /// Called when a job has ended, in job order, whichever ended first. Returns false to end the run.
    virtual bool Take(size_t job, const JobEnd& end) = 0;
    /// Called several times per second while jobs run, with the number of jobs that have ended.
    virtual void Tick(size_t) {}
};

} // namespace gw
