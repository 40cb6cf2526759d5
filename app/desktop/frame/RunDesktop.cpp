// Start and end of the desktop program: arguments, a second instance, the missing display, the main window or
// the map tool.

#include "RunDesktop.h"

#include "CGaitConvertFrame.h"
#include "CInstanceCounter.h"
#include "CInstanceServer.h"
#include "CLeftKeys.h"
#include "CMessageBox.h"
#include "CPreviewWidget.h"
#include "CSkin.h"
#include "CSystemPlatform.h"
#include "DesktopArguments.h"
#include "Paths.h"
#include "QuitOnSignals.h"
#include "RunMapTool.h"
#include "StringTable.h"

#include <QApplication>
#include <QLocale>
#include <QScreen>
#include <QStyleFactory>
#include <QTimer>
#include <cstdio>
#include <cstdlib>

namespace gw {

namespace {

constexpr const char* kSkinFolder = "Content";

constexpr const char* kUsage = "Usage: GaitForge [FILE]\n"
                               "       GaitForge -s                        the map tool\n"
                               "       GaitForge --reset-instance-counter  clear the lock after a crash\n";

constexpr const char* kBlocked =
    "GaitForge: another instance seems to be running, but it does not respond. If it crashed, run:\n"
    "GaitForge --reset-instance-counter\n";

// Reports why the program cannot run, in a window and on standard error.
void Complain(const std::string& words)
{
    std::fprintf(stderr, "GaitForge: %s\n", words.c_str());
    RunMessageBox(nullptr, std::string(BuiltInString(kTitleMessage)), words, EButtons::OK);
}

bool LoadSkin(CSkin& skin, const CPlatform& platform, std::string& problem)
{
    const bool loaded = skin.Load(platform.DataFolder() + kSkinFolder, problem);
    if (!loaded)
        return false;
    if (const QScreen* screen = QGuiApplication::primaryScreen())
        skin.ShrinkTo(screen->availableSize());
    qApp->setStyleSheet(skin.StyleSheet());
    return true;
}

void CheckTarget(const CPlatform& platform)
{
    const std::string path = platform.DataFolder() + kTargetFile;
    if (!FileExists(path))
        Complain("The target skeleton \"" + path +
                 "\" is missing. You can view motions, but not convert them.");
}

// Copies of the program in different folders are independent of each other.
std::string CounterName()
{
    return "gaitforge-" + std::to_string(std::hash<std::string>()(ExecutableFolder()));
}

// The program's slot in the instance counter, released at the end if it was taken.
class CInstanceShare
{
public:
    CInstanceShare() : m_kCounter(CounterName()), m_bOwner(m_kCounter.Enter() < 1) {}
    ~CInstanceShare() { m_kCounter.Leave(); }
    CInstanceShare(const CInstanceShare&) = delete;
    CInstanceShare& operator=(const CInstanceShare&) = delete;

    bool IsFirst() const { return m_bOwner; }

private:
    CInstanceCounter m_kCounter;
    bool m_bOwner;
};

int ShowMainWindow(const std::string& file, CPlatform& platform, const CLeftKeys& keys)
{
    CSkin skin;
    std::string problem;
    if (!LoadSkin(skin, platform, problem))
    {
        Complain("The window's skin cannot be used. " + problem);
        return EXIT_FAILURE;
    }
    CGaitConvertFrame frame(skin, keys, platform);
    const CInstanceServer server([&frame](const std::string& path) { frame.RaiseAndOpen(path); });
    frame.show();
    // Posted to the application's loop: outside it, a request to quit would only close the box and be
    // forgotten.
    QTimer::singleShot(0, &frame, [&] {
        frame.RaiseAndOpen(file);
        CheckTarget(platform);
    });
    return QApplication::exec();
}

int InitMain(const std::string& file, CPlatform& platform, const CLeftKeys& keys)
{
    const CInstanceShare share;
    if (RaiseFirstInstance(file))
        return EXIT_SUCCESS;
    if (share.IsFirst())
        return ShowMainWindow(file, platform, keys);
    std::fputs(kBlocked, stderr);
    return EXIT_FAILURE;
}

// The tool uses the skin's colors if they are available.
int RunTool(CPlatform& platform, const CLeftKeys& keys)
{
    CSkin skin;
    std::string problem;
    LoadSkin(skin, platform, problem);
    return RunMapTool(platform, keys);
}

int InitInstance(const DesktopArguments& arguments)
{
    CSystemPlatform platform(EPlatformWriting::Yes);
    const CLeftKeys keys;
    return arguments.mapTool ? RunTool(platform, keys) : InitMain(arguments.file, platform, keys);
}

// Handles arguments that need no screen. Returns nothing if a window is needed.
std::optional<int> RunWithoutWindow(const DesktopArguments& arguments)
{
    if (arguments.help)
        return std::fputs(kUsage, stdout) < 0 ? EXIT_FAILURE : EXIT_SUCCESS;
    if (arguments.resetCounter)
    {
        CInstanceCounter(CounterName()).Reset();
        return EXIT_SUCCESS;
    }
    return std::nullopt;
}

// The toolkit aborts without a screen.
bool HasDisplay()
{
#if defined(__linux__)
    for (const char* name : {"DISPLAY", "WAYLAND_DISPLAY", "QT_QPA_PLATFORM"})
    {
        if (const char* value = std::getenv(name); value && *value)
            return true;
    }
    return false;
#else
    return true;
#endif
}

} // namespace

int RunDesktop(int argc, char** argv)
{
    QStringList given;
    for (int i = 1; i < argc; ++i)
        given << QString::fromLocal8Bit(argv[i]);
    if (const auto code = RunWithoutWindow(ReadArguments(given)))
        return *code;
    if (!HasDisplay())
    {
        std::fputs("GaitForge: no display was found; \"gaitwright\" works without one\n", stderr);
        return EXIT_FAILURE;
    }
    RequestPreviewFormat();
    QApplication application(argc, argv);
    QApplication::setStyle(QStyleFactory::create(QStringLiteral("Fusion")));
    QLocale::setDefault(QLocale::c()); // same number format on every desktop
    QuitOnSignals(&application);
    return InitInstance(ReadArguments(QApplication::arguments().mid(1)));
}

} // namespace gw
