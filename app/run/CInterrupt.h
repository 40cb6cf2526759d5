#pragma once

#include <memory>

namespace gw {

/// While it exists, requests to end (Ctrl-C, SIGTERM, hang-up, a closed console) do not end the program but
/// are counted. Requests that were ignored at program start stay ignored.
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
    struct Before;
    std::unique_ptr<Before> m_spBefore; ///< what a request did before
};

} // namespace gw
