#include "StepBehind.h"

#include <pthread.h>
#include <sched.h>

namespace gw {

void StepBehind()
{
#if defined(SCHED_IDLE) // not on every system of this kind
    const sched_param none{};
    pthread_setschedparam(pthread_self(), SCHED_IDLE, &none);
#endif
}

} // namespace gw
