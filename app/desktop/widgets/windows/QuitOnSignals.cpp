#include "QuitOnSignals.h"

namespace gw {

// The system asks windows to close, at the end of a session too.
void QuitOnSignals(QObject*) {}

} // namespace gw
