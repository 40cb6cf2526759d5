#pragma once

class QObject;

namespace gw {

/// From now on, a signal that asks the program to end (from the terminal, or at shutdown) closes its windows
/// and ends its event loop, so that what it shares with other programs is released. To be called once; the
/// application must outlive the parent.
void QuitOnSignals(QObject* parent);

} // namespace gw
