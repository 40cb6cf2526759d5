#include "CInstanceServer.h"

#include <QDir>
#include <QFileInfo>

#include <unistd.h>

namespace gw {

namespace {

constexpr const char* kWindowClass = "TK_KESTRO_GAIT_CONV_1";
constexpr qsizetype kLongestSocketPath = 107; // maximum length of a socket's address in bytes

// Returns whether only the user can write to a folder.
bool IsPrivate(const QString& path)
{
    const QFileInfo folder(path);
    constexpr QFile::Permissions kOthers = QFile::WriteGroup | QFile::WriteOther;
    return folder.isAbsolute() && folder.isDir() && !folder.isSymLink() && folder.ownerId() == geteuid() &&
           !(folder.permissions() & kOthers);
}

// Returns a folder with the user's id in its name, created if necessary.
QString OwnFolder()
{
    QString path = QDir::tempPath() + QStringLiteral("/gaitwright-") + QString::number(geteuid());
    QDir().mkdir(path, QFile::ReadOwner | QFile::WriteOwner | QFile::ExeOwner);
    return path;
}

QString SocketIn(const QString& folder)
{
    const QString path = folder + QLatin1Char('/') + QLatin1String(kWindowClass);
    const bool fits = QFile::encodeName(path).size() <= kLongestSocketPath;
    return fits && IsPrivate(folder) ? path : QString();
}

} // namespace

QString InstanceSocketPath()
{
    const QString path = SocketIn(qEnvironmentVariable("XDG_RUNTIME_DIR"));
    return path.isEmpty() ? SocketIn(OwnFolder()) : path;
}

} // namespace gw
