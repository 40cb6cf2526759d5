#pragma once

#include <csignal>
#include <iterator>

namespace gw {

/// While it exists, requests to end (Ctrl-C, SIGTERM, hang-up) do not end the program but are counted.
/// Signals that were ignored at program start stay ignored.
class CInterrupt
{
public:
    CInterrupt();
    ~CInterrupt();
    CInterrupt(const CInterrupt&) = delete;
    CInterrupt& operator=(const CInterrupt&) = delete;

    /// Returns the number of requests.
    int Count() const;
    /// Ignores such requests in a child process; its parent decides when it ends.
    static void Ignore();

private:
    static constexpr int kSignals[] = {SIGINT, SIGTERM, SIGHUP};
    struct sigaction m_kBefore[std::size(kSignals)] = {};
};

} // namespace gw
