// A local socket over which a second start passes its file to the first instance. The socket is in a folder
// that only the user can write to, and every message is checked before it is used.

#include "CInstanceServer.h"

#include "InstanceMessage.h"
#include "QtText.h"

#include <QDeadlineTimer>
#include <QDir>
#include <QLocalSocket>
#include <QTimer>

namespace gw {

namespace {

constexpr int kClientMilliseconds = 800;
constexpr int kServerMilliseconds = 2000; // after which a silent client is disconnected

} // namespace

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
