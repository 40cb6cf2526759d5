#include "RunMapTool.h"

#include "CGaitToolWindow.h"

#include <QApplication>

namespace gw {

// Runs in the application's own loop instead of the dialog's: only that one ends when the system asks the
// program to end.
int RunMapTool(CPlatform& platform, const CLeftKeys& keys)
{
    CGaitToolWindow window(platform, keys);
    window.setModal(true);
    window.show();
    return QApplication::exec();
}

} // namespace gw
