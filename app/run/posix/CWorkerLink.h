#pragma once

#include "WorkerMessages.h"

namespace gw {

/// A worker's end of the connection to its program: a socket that keeps messages apart.
class CWorkerLink
{
public:
    explicit CWorkerLink(int socket) : m_iSocket(socket) {}

    /// Waits for an order. Returns false if the program has ended or has no more jobs.
    bool Receive(WorkerOrder& order);
    /// Returns false if the program has ended.
    bool Reply(const WorkerReply& reply);

private:
    int m_iSocket;
};

} // namespace gw
