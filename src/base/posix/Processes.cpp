#include "Processes.h"

#include "Paths.h"

#include <cerrno>
#include <csignal>
#include <cstdlib>
#include <random>

#include <dlfcn.h>
#include <unistd.h>

namespace gw {

uint32_t ProcessNumber()
{
    return static_cast<uint32_t>(getpid());
}

bool IsProcessGone(uint32_t number)
{
    return number != 0 && kill(static_cast<pid_t>(number), 0) != 0 && errno == ESRCH;
}

std::string MachineName()
{
    char name[256] = {};
    gethostname(name, sizeof name - 1);
    char processes[64] = {};
    if (readlink("/proc/self/ns/pid", processes, sizeof processes - 1) < 0)
        processes[0] = '\0';
    return std::string(name) + processes;
}

uint32_t RandomNumber()
{
    // the default asks the processor, which is slow in virtual machines
    std::random_device random("getentropy");
    return random();
}

std::string EnvironmentVariable(const char* name)
{
    const char* const value = std::getenv(name);
    return value ? value : "";
}

void* ModuleEntry(const std::string& module, const char* entry)
{
    void* const loaded = dlopen((ExecutableFolder() + module + ".so").c_str(), RTLD_NOW | RTLD_LOCAL);
    return loaded ? dlsym(loaded, entry) : nullptr;
}

} // namespace gw
