#include "DesktopServices.h"

#include "QtText.h"

#include <QCoreApplication>
#include <QDBusConnection>
#include <QDBusMessage>
#include <QDBusPendingCallWatcher>
#include <QDesktopServices>
#include <QFileInfo>
#include <QUrl>

namespace gw {

namespace {

// A file manager may have to start before it replies. The program does not wait for it.
constexpr int kFileManagerMilliseconds = 5000;

QDBusMessage ShowItems(const QString& url)
{
    const QString name = QStringLiteral("org.freedesktop.FileManager1");
    QDBusMessage call = QDBusMessage::createMethodCall(name, QStringLiteral("/org/freedesktop/FileManager1"),
                                                       name, QStringLiteral("ShowItems"));
    call << QStringList(url) << QString(); // the second one is for the desktop's startup notification
    return call;
}

bool OpenLocal(const QString& path)
{
    return QDesktopServices::openUrl(QUrl::fromLocalFile(path));
}

} // namespace

void ShowInFileManager(const std::string& path)
{
    const QFileInfo file(ToQString(path));
    const QString folder = file.absolutePath();
    const QDBusConnection bus = QDBusConnection::sessionBus();
    if (!bus.isConnected())
    {
        OpenLocal(folder);
        return;
    }
    const QString url = QUrl::fromLocalFile(file.absoluteFilePath()).toString(QUrl::FullyEncoded);
    auto* answer = new QDBusPendingCallWatcher(bus.asyncCall(ShowItems(url), kFileManagerMilliseconds), qApp);
    QObject::connect(answer, &QDBusPendingCallWatcher::finished, qApp,
                     [folder](QDBusPendingCallWatcher* finished) {
                         if (finished->isError())
                             OpenLocal(folder);
                         finished->deleteLater();
                     });
}

void OpenHelpFile(const std::string& path)
{
    OpenLocal(ToQString(path.substr(0, path.rfind("::"))));
}

bool OpenWebPage(const std::string& address)
{
    return QDesktopServices::openUrl(QUrl(ToQString(address)));
}

} // namespace gw
