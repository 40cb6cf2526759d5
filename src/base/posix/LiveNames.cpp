#include "LiveNames.h"

#include <csignal>

namespace gw {

namespace {

constexpr int kEndSignals[] = {SIGINT, SIGTERM, SIGHUP, SIGQUIT, SIGPIPE, SIGXCPU};

void EndBySignal(int signal)
{
    RemoveLiveFiles();
    raise(signal); // SA_RESETHAND has restored the default action, which runs when this handler returns
}

} // namespace

void RemovePrivateFilesOnSignals()
{
    struct sigaction action = {};
    action.sa_handler = EndBySignal;
    action.sa_flags = SA_RESETHAND;
    for (const int signal : kEndSignals)
        sigaddset(&action.sa_mask, signal);
    for (const int signal : kEndSignals)
    {
        struct sigaction before = {};
        sigaction(signal, nullptr, &before);
        if (before.sa_handler != SIG_IGN)
            sigaction(signal, &action, nullptr);
    }
}

} // namespace gw
