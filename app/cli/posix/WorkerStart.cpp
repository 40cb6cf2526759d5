// Workers are copies of the program, so they need no description of their work.

#include "WorkerStart.h"

#include "CFileRun.h"
#include "PageOutputDetails.h"

namespace gw {

void ServeIfWorker(int, char**) {}

std::string CFileRun::Description() const
{
    return {};
}

std::string CDetailHandler::Description() const
{
    return {};
}

} // namespace gw
