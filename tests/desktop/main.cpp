#include "CPreviewWidget.h"
#include "TempFolder.h"

#include <QApplication>
#include <gtest/gtest.h>

// The user's own settings and documents are neither read nor written.
int main(int argc, char** argv)
{
    testing::InitGoogleTest(&argc, argv);
    const gw::CTempFolder home;
    for (const char* name : {"HOME", "XDG_CONFIG_HOME", "XDG_CONFIG_DIRS", "XDG_RUNTIME_DIR"})
        qputenv(name, home.Path("").c_str());
    gw::RequestPreviewFormat();
    const QApplication application(argc, argv);
    return RUN_ALL_TESTS();
}
