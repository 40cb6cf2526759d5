// Loaded before a program, this makes one call fail: call number FAULT_NUMBER of FAULT_OPERATION by the
// program and its worker processes, counted from the start of main. The number of calls is written to
// FAULT_REPORT at the end. Calls within the system's library are not intercepted. Calls named in
// FAULT_MISSING (flock, link, renameat2) always fail, as on a file system without them.

#include <atomic>
#include <cerrno>
#include <cstdarg>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <iterator>
#include <new>

#include <dlfcn.h>
#include <fcntl.h>
#include <sys/file.h>
#include <sys/mman.h>
#include <sys/syscall.h>
#include <unistd.h>

// Allocation functions inside the system's library, under the names that remain when malloc is replaced.
extern "C" void* __libc_malloc(size_t size);
extern "C" void* __libc_calloc(size_t count, size_t size);

namespace {

enum class EOperation : int
{
    None,
    Open,
    Read,
    Write,
    Rename,
    Sync,
    Close,
    Map,
    Mode,
    Reserve,
    Allocate,
};

// Indexed by EOperation.
constexpr const char* kNames[] = {"none",  "open", "read", "write",   "rename",  "sync",
                                  "close", "map",  "mode", "reserve", "allocate"};

using Count = std::atomic<long>;

EOperation g_eOperation = EOperation::None;
long g_iNumber = 0;
Count* g_pkCalls = nullptr; // of the program and its workers

bool IsDue(EOperation operation)
{
    return operation == g_eOperation && ++*g_pkCalls == g_iNumber;
}

bool IsMissing(const char* call)
{
    const char* const missing = std::getenv("FAULT_MISSING");
    return missing && std::strstr(missing, call);
}

int Refuse(int error)
{
    errno = error;
    return -1;
}

// Returns the function that is being intercepted.
template <class F>
F* Next(const char* name)
{
    return reinterpret_cast<F*>(dlsym(RTLD_NEXT, name));
}

void Begin()
{
    const long shared =
        syscall(SYS_mmap, nullptr, sizeof(Count), PROT_READ | PROT_WRITE, MAP_SHARED | MAP_ANONYMOUS, -1, 0);
    g_pkCalls = new (reinterpret_cast<void*>(shared)) Count(0);
    const char* const operation = std::getenv("FAULT_OPERATION");
    const char* const number = std::getenv("FAULT_NUMBER");
    g_iNumber = number ? std::atol(number) : 0;
    for (size_t i = 0; operation && i < std::size(kNames); ++i)
    {
        if (std::strcmp(kNames[i], operation) == 0)
            g_eOperation = static_cast<EOperation>(i);
    }
}

// Uses system calls, so that reporting does not count as a call.
void Report()
{
    g_eOperation = EOperation::None;
    const char* const path = std::getenv("FAULT_REPORT");
    const long file = path ? syscall(SYS_openat, AT_FDCWD, path, O_WRONLY | O_CREAT | O_TRUNC, 0600) : -1;
    if (file < 0)
        return;
    char text[24];
    const int length = std::snprintf(text, sizeof text, "%ld", g_pkCalls->load());
    syscall(SYS_write, file, text, static_cast<size_t>(length));
    syscall(SYS_close, file);
}

int (*g_pkMain)(int, char**, char**) = nullptr;

int CountedMain(int argc, char** argv, char** environment)
{
    Begin();
    const int result = g_pkMain(argc, argv, environment);
    Report();
    return result;
}

mode_t ModeOf(int flags, va_list arguments)
{
    return flags & (O_CREAT | __O_TMPFILE) ? va_arg(arguments, mode_t) : 0;
}

} // namespace

extern "C" {

// The system starts programs through this function, so counting starts with main, after all initialization.
int __libc_start_main(int (*main)(int, char**, char**), int argc, char** argv, void (*init)(), void (*fini)(),
                      void (*loaderFini)(), void* stackEnd)
{
    g_pkMain = main;
    return Next<decltype(__libc_start_main)>("__libc_start_main")(CountedMain, argc, argv, init, fini,
                                                                  loaderFini, stackEnd);
}

int open(const char* path, int flags, ...)
{
    va_list arguments;
    va_start(arguments, flags);
    const mode_t mode = ModeOf(flags, arguments);
    va_end(arguments);
    return IsDue(EOperation::Open) ? Refuse(EACCES)
                                   : static_cast<int>(syscall(SYS_openat, AT_FDCWD, path, flags, mode));
}

int open64(const char* path, int flags, ...) __attribute__((alias("open")));

ssize_t read(int file, void* bytes, size_t count)
{
    return IsDue(EOperation::Read) ? Refuse(EIO) : syscall(SYS_read, file, bytes, count);
}

ssize_t write(int file, const void* bytes, size_t count)
{
    return IsDue(EOperation::Write) ? Refuse(ENOSPC) : syscall(SYS_write, file, bytes, count);
}

ssize_t pwrite(int file, const void* bytes, size_t count, off_t offset)
{
    return IsDue(EOperation::Write) ? Refuse(ENOSPC) : syscall(SYS_pwrite64, file, bytes, count, offset);
}

ssize_t pwrite64(int file, const void* bytes, size_t count, off_t offset) __attribute__((alias("pwrite")));

int rename(const char* from, const char* to)
{
    return IsDue(EOperation::Rename) ? Refuse(EIO) : static_cast<int>(syscall(SYS_rename, from, to));
}

int renameat2(int fromFolder, const char* from, int toFolder, const char* to, unsigned flags)
{
    if (IsMissing("renameat2"))
        return Refuse(EINVAL);
    return IsDue(EOperation::Rename)
               ? Refuse(EIO)
               : static_cast<int>(syscall(SYS_renameat2, fromFolder, from, toFolder, to, flags));
}

int link(const char* from, const char* to)
{
    return IsMissing("link") ? Refuse(EPERM) : static_cast<int>(syscall(SYS_link, from, to));
}

int flock(int file, int operation)
{
    return IsMissing("flock") ? Refuse(ENOLCK) : static_cast<int>(syscall(SYS_flock, file, operation));
}

int fsync(int file)
{
    return IsDue(EOperation::Sync) ? Refuse(EIO) : static_cast<int>(syscall(SYS_fsync, file));
}

int syncfs(int file)
{
    return IsDue(EOperation::Sync) ? Refuse(EIO) : static_cast<int>(syscall(SYS_syncfs, file));
}

int fchmod(int file, mode_t mode)
{
    return IsDue(EOperation::Mode) ? Refuse(EPERM) : static_cast<int>(syscall(SYS_fchmod, file, mode));
}

// The file is closed anyway; the failure is in what the file system still had to do.
int close(int file)
{
    const bool due = IsDue(EOperation::Close);
    const long result = syscall(SYS_close, file);
    return due ? Refuse(EIO) : static_cast<int>(result);
}

void* mmap(void* address, size_t length, int protection, int flags, int file, off_t offset)
{
    if (file >= 0 && IsDue(EOperation::Map))
    {
        errno = ENOMEM;
        return MAP_FAILED;
    }
    return reinterpret_cast<void*>(syscall(SYS_mmap, address, length, protection, flags, file, offset));
}

void* mmap64(void* address, size_t length, int protection, int flags, int file, off_t offset)
    __attribute__((alias("mmap")));

int posix_fallocate(int file, off_t offset, off_t length)
{
    if (IsDue(EOperation::Reserve))
        return ENOSPC;
    return Next<decltype(posix_fallocate)>("posix_fallocate")(file, offset, length);
}

int posix_fallocate64(int file, off_t offset, off_t length) __attribute__((alias("posix_fallocate")));

#ifndef GAITWRIGHT_SANITIZED
void* malloc(size_t size)
{
    if (!IsDue(EOperation::Allocate))
        return __libc_malloc(size);
    errno = ENOMEM;
    return nullptr;
}

void* calloc(size_t count, size_t size)
{
    if (!IsDue(EOperation::Allocate))
        return __libc_calloc(count, size);
    errno = ENOMEM;
    return nullptr;
}

#endif

} // extern "C"
