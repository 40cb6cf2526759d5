#pragma once

#include <QLocalServer>
#include <functional>
#include <string>

class QLocalSocket;

namespace gw {

/// The server of the first instance: later starts ask it to come to the front and can pass a file to open.
/// Only processes of the same user can reach it. Other messages are ignored.
class CInstanceServer : public QObject
{
public:
    /// Called with the absolute path of a file to open, or an empty one.
    using Raise = std::function<void(const std::string& path)>;

    /// Starts listening, replacing a dead owner if necessary. Does nothing if another instance is listening
    /// or no socket is available.
    explicit CInstanceServer(Raise raise, QObject* parent = nullptr);

    bool IsListening() const { return m_kServer.isListening(); }

private:
    void Listen();
    void Attend(QLocalSocket& socket);
    void Receive(QLocalSocket& socket);

    QLocalServer m_kServer;
    Raise m_kRaise;
};

/// Asks the first instance to come to the front and to open a file, unless the path is empty. Returns whether
/// an instance replied; waits less than a second.
bool RaiseFirstInstance(const std::string& path = {});

/// Returns the absolute path of the socket, in a folder owned by the user, or the name of the user's pipe.
/// Returns an empty text if the user does not have such a folder.
QString InstanceSocketPath();

} // namespace gw
