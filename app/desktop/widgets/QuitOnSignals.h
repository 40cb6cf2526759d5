#pragma once

class QObject;

namespace gw {

/// From now on a signal that asks the program to end (of the terminal, of the system that shuts down) ends
/// its loop of events, so that what it shares with other programs is given back. Once, under an application
/// that lives as long as the parent.
void QuitOnSignals(QObject* parent);

} // namespace gw
