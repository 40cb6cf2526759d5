#include "CornerMenu.h"

#include "CGaitConvertContent.h"
#include "CGaitConvertFrame.h"
#include "Paths.h"
#include "QtText.h"

#include <QCoreApplication>
#include <QFontMetrics>

namespace gw {

namespace {

constexpr int kPathPixels = 420;

QString Words(const char* text)
{
    return QCoreApplication::translate("CornerMenu", text);
}

void AddRecentFiles(QMenu& menu, CGaitConvertFrame& frame)
{
    const auto paths = frame.Content().RecentFiles();
    menu.addAction(Words(paths.empty() ? "No recent files" : "Recent files"))->setEnabled(false);
    for (int number = 1; const std::string& path : paths)
    {
        QString text = menu.fontMetrics().elidedText(ToQString(path), Qt::ElideMiddle, kPathPixels);
        text.replace(QLatin1Char('&'), QStringLiteral("&&"));
        QAction* const action = menu.addAction(QStringLiteral("&%1  %2").arg(number++).arg(text));
        action->setEnabled(FileExists(path));
        QObject::connect(action, &QAction::triggered, &frame, [&frame, path] { frame.OpenSoon(path); });
    }
    if (!paths.empty())
        QObject::connect(menu.addAction(Words("Clear recent files")), &QAction::triggered, &frame,
                         [&frame] { frame.Content().ClearRecentFiles(); });
}

void AddCommand(QMenu& menu, const char* text, const char* keys, CGaitConvertFrame& frame,
                void (*run)(CGaitConvertFrame&))
{
    const QString shown = Words(text) + QLatin1Char('\t') + QLatin1String(keys);
    QObject::connect(menu.addAction(shown), &QAction::triggered, &frame, [&frame, run] { run(frame); });
}

} // namespace

QMenu* MakeCornerMenu(CGaitConvertFrame& frame)
{
    auto* const menu = new QMenu(&frame);
    menu->setAttribute(Qt::WA_DeleteOnClose);
    AddRecentFiles(*menu, frame);
    menu->addSeparator();
    AddCommand(*menu, "Open...", "Ctrl+O", frame, [](CGaitConvertFrame& f) { f.Content().OpenSource(); });
    AddCommand(*menu, "Help", "F1", frame, [](CGaitConvertFrame& f) { f.Content().ChildClick("help"); });
    menu->addSeparator();
    AddCommand(*menu, "Minimize", "", frame, [](CGaitConvertFrame& f) { f.showMinimized(); });
    AddCommand(*menu, "Close", "Alt+F4", frame,
               [](CGaitConvertFrame& f) { f.Content().ChildClick("close"); });
    return menu;
}

} // namespace gw
