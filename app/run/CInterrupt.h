#pragma once

#include <csignal>
#include <iterator>

namespace gw {

/// While it lives, a request to end (Ctrl-C, SIGTERM, a hang-up) does not end the program but is counted. A
/// request that the program was started to ignore stays ignored.
class CInterrupt
{
public:
    CInterrupt();
    ~CInterrupt();
    CInterrupt(const CInterrupt&) = delete;
    CInterrupt& operator=(const CInterrupt&) = delete;

    /// How often an end was requested.
    int Count() const;
    /// For a child of the program: whoever started it tells it when to end.
    static void Ignore();

private:
    static constexpr int kSignals[] = {SIGINT, SIGTERM, SIGHUP};
    struct sigaction m_kBefore[std::size(kSignals)] = {};
};

} // namespace gw
