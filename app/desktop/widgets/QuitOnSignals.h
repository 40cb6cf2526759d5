#pragma once

class QObject;

namespace gw {

/// Makes signals that ask the program to end (from the terminal, or at shutdown) close its windows and end
/// its event loop, so that everything it shares with other programs is released. Call it once; the
/// application must outlive the parent.
void QuitOnSignals(QObject* parent);

} // namespace gw
