#include "StepBehind.h"

#include "WindowsCalls.h"

namespace gw {

void StepBehind()
{
    SetThreadPriority(GetCurrentThread(), THREAD_PRIORITY_IDLE);
}

} // namespace gw
