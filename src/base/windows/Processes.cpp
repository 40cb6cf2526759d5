#include "Processes.h"

#include "Paths.h"
#include "WindowsCalls.h"

#include <cstdlib>
#include <iterator>
#include <random>

namespace gw {

uint32_t ProcessNumber()
{
    return GetCurrentProcessId();
}

// Another user's process cannot be opened, but exists.
bool IsProcessGone(uint32_t number)
{
    const CHandle process(OpenProcess(PROCESS_QUERY_LIMITED_INFORMATION | SYNCHRONIZE, FALSE, number));
    if (!process)
        return number != 0 && GetLastError() == ERROR_INVALID_PARAMETER;
    return WaitForSingleObject(process.Get(), 0) == WAIT_OBJECT_0; // somebody still has it open
}

std::string MachineName()
{
    wchar_t name[256];
    DWORD size = static_cast<DWORD>(std::size(name));
    return GetComputerNameExW(ComputerNameDnsHostname, name, &size) ? NarrowText({name, size})
                                                                    : std::string();
}

uint32_t RandomNumber()
{
    std::random_device random; // the system's generator
    return random();
}

std::string EnvironmentVariable(const char* name)
{
    const wchar_t* const value = _wgetenv(WideText(name).c_str());
    return value ? NarrowText(value) : std::string();
}

void* ModuleEntry(const std::string& module, const char* entry)
{
    const std::wstring path = WidePath(ExecutableFolder() + module + ".dll");
    const HMODULE loaded = LoadLibraryExW(path.c_str(), nullptr, LOAD_WITH_ALTERED_SEARCH_PATH);
    return loaded ? reinterpret_cast<void*>(GetProcAddress(loaded, entry)) : nullptr;
}

} // namespace gw
