#include "CWorkerLink.h"

#include <cerrno>

#include <sys/socket.h>

namespace gw {

bool CWorkerLink::Receive(WorkerOrder& order)
{
    ssize_t count = 0;
    do
        count = recv(m_iSocket, &order, sizeof order, 0);
    while (count < 0 && errno == EINTR);
    return count == sizeof order;
}

bool CWorkerLink::Reply(const WorkerReply& reply)
{
    return send(m_iSocket, &reply, sizeof reply, MSG_NOSIGNAL) == sizeof reply;
}

} // namespace gw
