#include "CInterrupt.h"

#include <csignal>
#include <iterator>

namespace gw {

namespace {

constexpr int kSignals[] = {SIGINT, SIGTERM, SIGHUP};

// The only thing a handler may touch.
volatile std::sig_atomic_t requests = 0;

void TakeRequest(int)
{
    requests = requests + 1;
}

} // namespace

struct CInterrupt::Before
{
    struct sigaction actions[std::size(kSignals)] = {};
};

CInterrupt::CInterrupt() : m_spBefore(std::make_unique<Before>())
{
    requests = 0;
    struct sigaction action = {};
    action.sa_handler = TakeRequest; // without SA_RESTART, so that waits return immediately
    for (size_t i = 0; i < std::size(kSignals); ++i)
    {
        struct sigaction& before = m_spBefore->actions[i];
        sigaction(kSignals[i], nullptr, &before);
        if (before.sa_handler != SIG_IGN)
            sigaction(kSignals[i], &action, nullptr);
    }
}

CInterrupt::~CInterrupt()
{
    for (size_t i = 0; i < std::size(kSignals); ++i)
        sigaction(kSignals[i], &m_spBefore->actions[i], nullptr);
}

int CInterrupt::Count() const
{
    return requests;
}

void CInterrupt::Ignore()
{
    for (const int signal : kSignals)
        std::signal(signal, SIG_IGN);
}

} // namespace gw
