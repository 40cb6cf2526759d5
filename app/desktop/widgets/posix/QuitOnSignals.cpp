#include "QuitOnSignals.h"

#include <QApplication>
#include <QSocketNotifier>
#include <QWidget>

#include <csignal>
#include <sys/socket.h>
#include <unistd.h>

namespace gw {

namespace {

int g_signalPipe[2] = {-1, -1};

// A handler can do almost nothing, so it sends a byte that wakes the event loop.
void Note(int)
{
    const char byte = 0;
    [[maybe_unused]] const ssize_t written = ::write(g_signalPipe[0], &byte, 1);
}

// The byte must be read, or this would be called again and again. Quitting closes open dialogs but has no
// other effect until the application's own loop runs; until then, a dialog runs its own loop.
void Quit()
{
    char byte = 0;
    [[maybe_unused]] const ssize_t count = ::read(g_signalPipe[1], &byte, 1);
    QCoreApplication::quit();
    if (QWidget* const dialog = QApplication::activeModalWidget())
        dialog->close();
}

} // namespace

void QuitOnSignals(QObject* parent)
{
    if (::socketpair(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0, g_signalPipe) != 0)
        return;
    auto* const notifier = new QSocketNotifier(g_signalPipe[1], QSocketNotifier::Read, parent);
    QObject::connect(notifier, &QSocketNotifier::activated, parent, Quit);
    for (const int number : {SIGTERM, SIGINT, SIGHUP})
        std::signal(number, Note);
}

} // namespace gw
