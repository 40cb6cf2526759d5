#include "RunMapTool.h"

#include "CGaitToolWindow.h"

#include <QApplication>

namespace gw {

// By the application's own loop and not by the dialog's: only that one ends when the system asks the program
// to.
int RunMapTool(CPlatform& platform, const CLeftKeys& keys)
{
    CGaitToolWindow window(platform, keys);
    window.setModal(true);
    window.show();
    return QApplication::exec();
}

} // namespace gw
