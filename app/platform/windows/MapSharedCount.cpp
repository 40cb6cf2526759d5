// A count in named memory of the user's session. The system frees the memory with the last counter that has
// opened it, so a crash is forgotten once no instance is left.

#include "MapSharedCount.h"

#include "WindowsCalls.h"

namespace gw {

std::string SharedCountName(const std::string& name)
{
    return "Local\\" + name;
}

// The handle stays open: a view keeps the memory, but not its name.
std::shared_ptr<int32_t> MapSharedCount(const std::string& sharedName)
{
    const HANDLE mapping = CreateFileMappingW(INVALID_HANDLE_VALUE, nullptr, PAGE_READWRITE, 0,
                                              sizeof(int32_t), WideText(sharedName).c_str());
    if (!mapping)
        return std::make_shared<int32_t>(0);
    void* const memory = MapViewOfFile(mapping, FILE_MAP_WRITE, 0, 0, sizeof(int32_t));
    if (!memory)
    {
        CloseHandle(mapping);
        return std::make_shared<int32_t>(0);
    }
    return {static_cast<int32_t*>(memory), [mapping](int32_t* count) {
                UnmapViewOfFile(count);
                CloseHandle(mapping);
            }};
}

} // namespace gw
