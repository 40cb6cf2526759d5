#pragma once

#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <string>

namespace gw {

/// How a job ended, and what it said.
struct JobEnd
{
    enum class EKind : uint8_t
    {
        Ran,      ///< to its end; `answer` is what it answered
        Died,     ///< its process died; `status` is what waitpid told
        TimedOut, ///< its process was ended, since it took longer than a job may
    };

    EKind kind = EKind::Ran;
    uint8_t answer = 0;
    int status = 0;
    double seconds = 0.0; ///< of work, without waiting for its turn
    std::string output;   ///< what it printed on standard output
    std::string words;    ///< and on standard error
    std::string record;   ///< and what it wrote into its record
};

/// What the jobs of a pool are. Jobs are numbers from 0 on.
class CJobHandler
{
public:
    virtual ~CJobHandler() = default;

    /// Does a job. Runs in a worker process, which is a copy of the program as it stood when it was started:
    /// what it changes in memory stays there. Answers a number of the handler's own.
    virtual uint8_t Run(size_t job, std::FILE* record) = 0;
    /// A job's result lies complete under a private path and takes its place next. Runs in the worker.
    virtual void Ready(size_t, const std::string&) {}
    /// A job's process is gone; nobody works on it any longer. Comes at once.
    virtual void Lost(size_t) {}
    /// A job ended. Comes in the order of the jobs, whichever ended first. False ends the run.
    virtual bool Take(size_t job, const JobEnd& end) = 0;
    /// Comes several times a second while jobs run, with the number of those that have ended.
    virtual void Tick(size_t) {}
};

} // namespace gw
