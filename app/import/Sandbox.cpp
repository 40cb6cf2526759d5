#include "Sandbox.h"

#include <algorithm>
#include <cerrno>
#include <csignal>
#include <cstdint>
#include <memory>

#include <fcntl.h>
#include <sched.h>
#include <seccomp.h>
#include <sys/prctl.h>
#include <sys/resource.h>

namespace gw {

namespace {

constexpr rlim_t kMemoryBytes = rlim_t{4} << 30;
constexpr rlim_t kComputingSeconds = 300;

// A lower limit of whoever started the program stays: not everybody may raise it.
bool Limit(__rlimit_resource resource, rlim_t most)
{
    rlimit limit{};
    if (getrlimit(resource, &limit) != 0)
        return false;
    limit.rlim_max = std::min(limit.rlim_max, most);
    limit.rlim_cur = std::min(limit.rlim_cur, limit.rlim_max);
    return setrlimit(resource, &limit) == 0;
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

using Filter = std::unique_ptr<void, void (*)(void*)>;
constexpr uint32_t kRefuse = SCMP_ACT_ERRNO(EPERM);

// Nothing that reads a file needs these calls. They fail as if they were not permitted, so that the library
// reports an error instead of dying.
constexpr int kForbidden[] = {SCMP_SYS(socket),
                              SCMP_SYS(socketpair),
                              SCMP_SYS(connect),
                              SCMP_SYS(bind),
                              SCMP_SYS(execve),
                              SCMP_SYS(execveat),
                              SCMP_SYS(fork),
                              SCMP_SYS(vfork),
                              SCMP_SYS(ptrace),
                              SCMP_SYS(unlink),
                              SCMP_SYS(unlinkat),
                              SCMP_SYS(rmdir),
                              SCMP_SYS(rename),
                              SCMP_SYS(renameat),
                              SCMP_SYS(renameat2),
                              SCMP_SYS(creat),
                              SCMP_SYS(openat2),
                              SCMP_SYS(mkdir),
                              SCMP_SYS(mkdirat),
                              SCMP_SYS(mknod),
                              SCMP_SYS(mknodat),
                              SCMP_SYS(link),
                              SCMP_SYS(linkat),
                              SCMP_SYS(symlink),
                              SCMP_SYS(symlinkat),
                              SCMP_SYS(truncate),
                              SCMP_SYS(ftruncate),
                              SCMP_SYS(chmod),
                              SCMP_SYS(fchmod),
                              SCMP_SYS(fchmodat),
                              SCMP_SYS(chown),
                              SCMP_SYS(fchown),
                              SCMP_SYS(lchown),
                              SCMP_SYS(fchownat),
                              SCMP_SYS(utimensat),
                              SCMP_SYS(setxattr),
                              SCMP_SYS(lsetxattr),
                              SCMP_SYS(fsetxattr),
                              SCMP_SYS(kill),
                              SCMP_SYS(pidfd_open),
                              SCMP_SYS(process_vm_writev),
                              SCMP_SYS(io_uring_setup)};

// Opening a file is forbidden with each of these flags: the first two are to write to it.
constexpr unsigned kForbiddenFlags[] = {O_WRONLY, O_RDWR, O_CREAT, O_TRUNC};

bool ForbidOpening(const Filter& filter, int call, unsigned flagsArgument)
{
    for (const unsigned flag : kForbiddenFlags)
    {
        const scmp_arg_cmp hasFlag{flagsArgument, SCMP_CMP_MASKED_EQ, flag, flag};
        if (seccomp_rule_add_array(filter.get(), kRefuse, call, 1, &hasFlag) != 0)
            return false;
    }
    return true;
}

// A new process is a clone without the memory of this one. What clone3 does is not visible to a filter, but
// those who use it fall back to clone.
bool ForbidProcesses(const Filter& filter)
{
    const scmp_arg_cmp isProcess{0, SCMP_CMP_MASKED_EQ, CLONE_VM, 0};
    return seccomp_rule_add_array(filter.get(), kRefuse, SCMP_SYS(clone), 1, &isProcess) == 0 &&
           seccomp_rule_add(filter.get(), SCMP_ACT_ERRNO(ENOSYS), SCMP_SYS(clone3), 0) == 0;
}

bool ForbidCalls()
{
    const Filter filter(seccomp_init(SCMP_ACT_ALLOW), seccomp_release);
    if (!filter)
        return false;
    for (const int call : kForbidden)
    {
        if (seccomp_rule_add(filter.get(), kRefuse, call, 0) != 0)
            return false;
    }
    return ForbidProcesses(filter) && ForbidOpening(filter, SCMP_SYS(open), 1) &&
           ForbidOpening(filter, SCMP_SYS(openat), 2) && seccomp_load(filter.get()) == 0;
}

} // namespace

bool EnterSandbox()
{
    prctl(PR_SET_PDEATHSIG, SIGKILL); // nobody reads the result of a reader that is gone
    return LimitMemory() && Limit(RLIMIT_CPU, kComputingSeconds) && Limit(RLIMIT_CORE, 0) &&
           Limit(RLIMIT_FSIZE, 0) && ForbidCalls();
}

} // namespace gw
