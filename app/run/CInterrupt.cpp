#include "CInterrupt.h"

#include <iterator>

namespace gw {

namespace {

// The only thing a handler may touch.
volatile std::sig_atomic_t requests = 0;

void TakeRequest(int)
{
    requests = requests + 1;
}

} // namespace

CInterrupt::CInterrupt()
{
    requests = 0;
    struct sigaction action = {};
    action.sa_handler = TakeRequest; // without SA_RESTART, so that waits return immediately
    for (size_t i = 0; i < std::size(kSignals); ++i)
    {
        sigaction(kSignals[i], nullptr, &m_kBefore[i]);
        if (m_kBefore[i].sa_handler != SIG_IGN)
            sigaction(kSignals[i], &action, nullptr);
    }
}

CInterrupt::~CInterrupt()
{
    for (size_t i = 0; i < std::size(kSignals); ++i)
        sigaction(kSignals[i], &m_kBefore[i], nullptr);
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
