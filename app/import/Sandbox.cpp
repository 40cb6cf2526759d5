#include "Sandbox.h"

#include <csignal>
#include <memory>

#include <seccomp.h>
#include <sys/prctl.h>
#include <sys/resource.h>

namespace gw {

namespace {

constexpr rlim_t kMemoryBytes = rlim_t{6} << 30;
constexpr rlim_t kComputingSeconds = 300;

bool Limit(int resource, rlim_t most)
{
    const rlimit limit{most, most};
    return setrlimit(static_cast<__rlimit_resource>(resource), &limit) == 0;
}

// The address sanitizer reserves more addresses than any limit.
bool LimitMemory()
{
#ifdef __SANITIZE_ADDRESS__
    return true;
#else
    return Limit(RLIMIT_AS, kMemoryBytes);
#endif
}

// Nothing that reads a file needs these calls. They fail as if they were not permitted, so that the library
// reports an error instead of dying.
bool ForbidCalls()
{
    constexpr int kForbidden[] = {
        SCMP_SYS(socket),   SCMP_SYS(socketpair), SCMP_SYS(connect),  SCMP_SYS(bind),      SCMP_SYS(execve),
        SCMP_SYS(execveat), SCMP_SYS(fork),       SCMP_SYS(vfork),    SCMP_SYS(ptrace),    SCMP_SYS(unlink),
        SCMP_SYS(unlinkat), SCMP_SYS(rename),     SCMP_SYS(renameat), SCMP_SYS(renameat2), SCMP_SYS(kill)};
    const std::unique_ptr<void, void (*)(void*)> filter(seccomp_init(SCMP_ACT_ALLOW), seccomp_release);
    if (!filter)
        return false;
    for (const int call : kForbidden)
    {
        if (seccomp_rule_add(filter.get(), SCMP_ACT_ERRNO(1), call, 0) != 0)
            return false;
    }
    return seccomp_load(filter.get()) == 0;
}

} // namespace

bool EnterSandbox()
{
    prctl(PR_SET_PDEATHSIG, SIGKILL); // nobody reads the result of a reader that is gone
    return LimitMemory() && Limit(RLIMIT_CPU, kComputingSeconds) && Limit(RLIMIT_CORE, 0) &&
           Limit(RLIMIT_FSIZE, 0) && ForbidCalls();
}

} // namespace gw
