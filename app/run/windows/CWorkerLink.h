#pragma once

#include "WorkerMessages.h"

namespace gw {

/// A worker's end of the connection to its program: a pipe for each direction, and an event that the program
/// waits for. The handles are those of the system.
class CWorkerLink
{
public:
    CWorkerLink(void* orders, void* replies, void* event)
        : m_pkOrders(orders), m_pkReplies(replies), m_pkEvent(event)
    {
    }

    /// Waits for an order. Returns false if the program has ended or has no more jobs.
    bool Receive(WorkerOrder& order);
    /// Returns false if the program has ended.
    bool Reply(const WorkerReply& reply);

private:
    void* m_pkOrders;
    void* m_pkReplies;
    void* m_pkEvent;
};

} // namespace gw
