#include "RunDesktop.h"

#include "Arguments.h"
#include "CFilePlatform.h"
#include "CGaitConvertContent.h"
#include "CGaitConvertFrame.h"
#include "CLeftKeys.h"
#include "CPreviewWidget.h"
#include "CSkin.h"
#include "Paths.h"
#include "QtText.h"
#include "RunMapTool.h"
#include "Stubs.h"

#include <QApplication>
#include <QLocale>
#include <QStyleFactory>
#include <cstdio>
#include <cstdlib>

namespace gw {

namespace {

constexpr const char* kProduct = "Gaitwright v2.0";
constexpr const char* kSkinFolder = "Content";
constexpr const char* kTargetFile = "base.htr";

constexpr const char* kUsage =
    "Usage: GaitForge [FILE]\n"
    "       GaitForge -s                        the map tool\n"
    "       GaitForge --reset-instance-counter  after a crash that blocks every start\n";

// Says what keeps the program from working, in a window and for whoever started it from a shell.
void Complain(const std::string& words)
{
    std::fprintf(stderr, "GaitForge: %s\n", words.c_str());
    RunMessageBox(nullptr, kProduct, words, EButtons::OK);
}

bool LoadSkin(CSkin& skin, const CPlatform& platform)
{
    std::string problem;
    if (!skin.Load(platform.DataFolder() + kSkinFolder, problem))
    {
        Complain("The window's skin cannot be used. " + problem);
        return false;
    }
    qApp->setStyleSheet(skin.StyleSheet());
    return true;
}

void CheckTarget(const CPlatform& platform)
{
    const std::string path = platform.DataFolder() + kTargetFile;
    if (!FileExists(path))
        Complain("The target skeleton \"" + path +
                 "\" is missing. Motions can be looked at, and none can be converted.");
}

int RunMainWindow(const DesktopArguments& arguments, CPlatform& platform, const CLeftKeys& keys)
{
    CSkin skin;
    if (!LoadSkin(skin, platform))
        return EXIT_FAILURE;
    CGaitConvertFrame frame(skin, keys, platform);
    frame.show();
    frame.activateWindow();
    CheckTarget(platform);
    if (!arguments.file.empty())
        frame.OpenSoon(arguments.file);
    return QApplication::exec();
}

int RunTool(CPlatform& platform, const CLeftKeys& keys)
{
    CSkin skin;
    return LoadSkin(skin, platform) ? RunMapTool(platform, keys) : EXIT_FAILURE;
}

} // namespace

int RunDesktop(int argc, char** argv)
{
    RequestPreviewFormat();
    const QApplication application(argc, argv);
    QApplication::setStyle(QStyleFactory::create(QStringLiteral("Fusion")));
    QLocale::setDefault(QLocale::c());

    const DesktopArguments arguments = ReadArguments(QApplication::arguments().mid(1));
    if (arguments.help)
        return std::fputs(kUsage, stdout) < 0 ? EXIT_FAILURE : EXIT_SUCCESS;
    CFilePlatform platform(EPlatformWriting::Yes);
    const CLeftKeys keys;
    return arguments.mapTool ? RunTool(platform, keys) : RunMainWindow(arguments, platform, keys);
}

} // namespace gw
