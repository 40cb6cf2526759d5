#pragma once

#include "CWorkerLoop.h"

#include <string>
#include <string_view>

namespace gw {

/// The program's argument that makes it a worker; a CWorkerStart as text follows.
inline constexpr const char* kWorkerArgument = "--worker";

/// What a program gets that starts as a worker: handles that it has inherited, and the description of its
/// handler.
class CWorkerStart
{
public:
    enum EHandle : int
    {
        Orders,
        Replies,
        Event,
        Output,
        Words,
        Record,
        Task, ///< memory with the description
        Count
    };

    void* handles[Count] = {};
    uint64_t taskBytes = 0;
    ECommit commit = ECommit::AtOnce;

    std::string Text() const;
    /// Returns false if the text is not that of a start.
    bool Read(std::string_view text);

    /// Returns the handler's description; empty if it cannot be read.
    std::string Description() const;
    /// Does the jobs that the program sends, and ends the process.
    [[noreturn]] void Serve(CJobHandler& handler) const;
};

} // namespace gw
