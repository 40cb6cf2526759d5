#include "StandardStreams.h"

#include "Paths.h"
#include "Text.h"
#include "WindowsCalls.h"

#include <algorithm>
#include <cstdio>
#include <cstdlib>

#include <fcntl.h>
#include <io.h>

namespace gw {

namespace {

// Devices that exist in every folder, whatever the extension.
constexpr std::string_view kDevices[] = {"NUL", "CON", "CONIN$", "CONOUT$", "AUX", "PRN"};

UINT codePage = 0; // of the console, before the program

void RestoreCodePage()
{
    SetConsoleOutputCP(codePage);
}

// Texts are UTF-8, and lines may be colored and redrawn.
void PrepareConsole()
{
    codePage = GetConsoleOutputCP();
    if (codePage != 0 && codePage != CP_UTF8 && SetConsoleOutputCP(CP_UTF8) != 0)
        std::atexit(RestoreCodePage); // the console outlives the program
    for (const DWORD stream : {STD_OUTPUT_HANDLE, STD_ERROR_HANDLE})
    {
        const HANDLE console = GetStdHandle(stream);
        DWORD mode = 0;
        if (GetConsoleMode(console, &mode))
            SetConsoleMode(console, mode | ENABLE_VIRTUAL_TERMINAL_PROCESSING);
    }
}

bool IsClosed(int stream)
{
    const intptr_t handle = _get_osfhandle(stream); // -1 without a file, -2 without a handle
    return handle < 0 || GetFileType(reinterpret_cast<HANDLE>(handle)) == FILE_TYPE_UNKNOWN;
}

} // namespace

void PrepareStandardStreams()
{
    std::FILE* const streams[] = {stdin, stdout, stderr};
    const char* const modes[] = {"rb", "wb", "wb"};
    for (int i = 0; i < 3; ++i)
    {
        if (_fileno(streams[i]) < 0 || IsClosed(_fileno(streams[i])))
            std::freopen("NUL", modes[i], streams[i]);
        else
            _setmode(_fileno(streams[i]), _O_BINARY);
    }
    std::setvbuf(stderr, nullptr, _IONBF, 0);
    PrepareConsole();
}

bool IsStreamPath(const std::string& path)
{
    if (path.starts_with(R"(\\.\)"))
        return true;
    const PathParts parts = SplitPath(path);
    return std::ranges::any_of(kDevices,
                               [&](std::string_view name) { return EqualNoCase(parts.stem, name); });
}

bool IsStandardOutputPath(const std::string& path)
{
    return EqualNoCase(path, "CON") || EqualNoCase(path, "CONOUT$");
}

std::string_view ForbiddenInFileNames()
{
    return {"/\\\0:*?\"<>|", 10};
}

} // namespace gw
