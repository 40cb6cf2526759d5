#include "QuitOnSignals.h"

#include <QCoreApplication>
#include <QSocketNotifier>

#ifndef _WIN32
#include <csignal>
#include <sys/socket.h>
#include <unistd.h>
#endif

namespace gw {

#ifdef _WIN32

void QuitOnSignals(QObject*) {}

#else

namespace {

int g_signalPipe[2] = {-1, -1};

// A handler may do next to nothing: the loop of events learns of the signal by a byte.
void Note(int)
{
    const char byte = 0;
    [[maybe_unused]] const ssize_t written = ::write(g_signalPipe[0], &byte, 1);
}

} // namespace

void QuitOnSignals(QObject* parent)
{
    if (::socketpair(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0, g_signalPipe) != 0)
        return;
    auto* const notifier = new QSocketNotifier(g_signalPipe[1], QSocketNotifier::Read, parent);
    QObject::connect(notifier, &QSocketNotifier::activated, parent, [] { QCoreApplication::quit(); });
    for (const int number : {SIGTERM, SIGINT, SIGHUP})
        std::signal(number, Note);
}

#endif

} // namespace gw
