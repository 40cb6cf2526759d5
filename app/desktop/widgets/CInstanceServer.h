#pragma once

#include <QLocalServer>
#include <functional>
#include <string>

class QLocalSocket;

namespace gw {

/// The first instance's ear: later starts ask it to come to the front, and may hand it a file to open. Only
/// processes of the same user reach it. What is no such request is passed over.
class CInstanceServer : public QObject
{
public:
    /// Gets the absolute path of a file to open, or an empty one.
    using Raise = std::function<void(const std::string& path)>;

    /// Listens at once, in the place of an owner that died if need be. It is silent where a living one
    /// listens and where the system gives no socket.
    explicit CInstanceServer(Raise raise, QObject* parent = nullptr);

    bool IsListening() const { return m_kServer.isListening(); }

private:
    void Listen();
    void Attend(QLocalSocket& socket);
    void Receive(QLocalSocket& socket);

    QLocalServer m_kServer;
    Raise m_kRaise;
};

/// Asks the first instance to come to the front and to open a file, if there is a path. Whether a living one
/// answered; waits for less than a second.
bool RaiseFirstInstance(const std::string& path = {});

/// Where first and later instances meet: the absolute path of a socket in a folder of the user's own. Empty
/// where there is no such folder.
QString InstanceSocketPath();

} // namespace gw
