// A local socket over which a second start passes its file to the first instance. The socket is in a folder
// that only the user can write to, and every message is checked before it is used.

#include "CInstanceServer.h"

#include "InstanceMessage.h"
#include "QtText.h"

#include <QDeadlineTimer>
#include <QDir>
#include <QFileInfo>
#include <QLocalSocket>
#include <QTimer>

#include <unistd.h>

namespace gw {

namespace {

constexpr const char* kWindowClass = "TK_KESTRO_GAIT_CONV_1";
constexpr qsizetype kLongestSocketPath = 107; // maximum length of a socket's address in bytes
constexpr int kClientMilliseconds = 800;
constexpr int kServerMilliseconds = 2000; // after which a silent client is disconnected

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

CInstanceServer::CInstanceServer(Raise raise, QObject* parent) : QObject(parent), m_kRaise(std::move(raise))
{
    connect(&m_kServer, &QLocalServer::newConnection, this, [this] {
        while (QLocalSocket* socket = m_kServer.nextPendingConnection())
            Attend(*socket);
    });
    Listen();
}

// Without socket options: with them, the toolkit takes over the name of a running owner.
void CInstanceServer::Listen()
{
    const QString path = InstanceSocketPath();
    if (path.isEmpty() || m_kServer.listen(path))
        return;
    QLocalSocket owner;
    owner.connectToServer(path);
    const bool isAlive = owner.waitForConnected(kClientMilliseconds);
    if (isAlive || owner.error() != QLocalSocket::ConnectionRefusedError)
        return;
    QLocalServer::removeServer(path);
    m_kServer.listen(path);
}

void CInstanceServer::Attend(QLocalSocket& socket)
{
    socket.setReadBufferSize(kMessageHead + kLongestPath + 1);
    connect(&socket, &QLocalSocket::readyRead, this, [this, &socket] { Receive(socket); });
    connect(&socket, &QLocalSocket::disconnected, &socket, [&socket] { socket.deleteLater(); });
    QTimer::singleShot(kServerMilliseconds, &socket, [&socket] { socket.abort(); });
}

void CInstanceServer::Receive(QLocalSocket& socket)
{
    std::string path;
    const EMessageState message = ReadMessage(socket.peek(socket.bytesAvailable()), path);
    if (message == EMessageState::Partial)
        return;
    socket.disconnect(this);
    if (message == EMessageState::Wrong)
    {
        socket.abort();
        return;
    }
    socket.write(&kMessageAnswer, 1);
    socket.flush();
    socket.disconnectFromServer();
    // Deferred: opening a file can ask questions, and the client must not wait for the answers.
    QMetaObject::invokeMethod(
        this, [this, path] { m_kRaise(path); }, Qt::QueuedConnection);
}

bool RaiseFirstInstance(const std::string& path)
{
    // The first instance can have another current folder.
    const std::string absolute =
        path.empty() ? path : ToUtf8(QDir::current().absoluteFilePath(ToQString(path)));
    const QDeadlineTimer deadline(kClientMilliseconds);
    const auto remaining = [&] { return static_cast<int>(deadline.remainingTime()); };
    const QString socketPath = InstanceSocketPath();
    QLocalSocket socket;
    socket.connectToServer(socketPath);
    if (socketPath.isEmpty() || !socket.waitForConnected(remaining()))
        return false;
    socket.write(MakeMessage(absolute));
    char answer = 0;
    return socket.waitForReadyRead(remaining()) && socket.getChar(&answer) && answer == kMessageAnswer;
}

} // namespace gw
