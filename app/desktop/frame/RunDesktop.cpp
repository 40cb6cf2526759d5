#include "RunDesktop.h"

#include "CPreviewWidget.h"

#include <QApplication>

namespace gw {

int RunDesktop(int argc, char** argv)
{
    RequestPreviewFormat();
    const QApplication application(argc, argv);
    return HasOpenGL() ? 0 : 1;
}

} // namespace gw
