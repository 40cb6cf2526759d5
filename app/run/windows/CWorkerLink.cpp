#include "CWorkerLink.h"

#include "WindowsCalls.h"

namespace gw {

// A message is far smaller than the buffer of a pipe, and at most one is on its way, so it always arrives
// whole.
bool CWorkerLink::Receive(WorkerOrder& order)
{
    DWORD count = 0;
    return ReadFile(m_pkOrders, &order, sizeof order, &count, nullptr) != 0 && count == sizeof order;
}

bool CWorkerLink::Reply(const WorkerReply& reply)
{
    DWORD count = 0;
    const bool good =
        WriteFile(m_pkReplies, &reply, sizeof reply, &count, nullptr) != 0 && count == sizeof reply;
    return SetEvent(m_pkEvent) != 0 && good;
}

} // namespace gw
