#include "SystemError.h"

#include "WindowsCalls.h"

#include <iterator>

namespace gw {

namespace {

constexpr WORD kEnglish = MAKELANGID(LANG_ENGLISH, SUBLANG_ENGLISH_US);
constexpr WORD kAnyLanguage = 0;

std::string SystemText(DWORD code, WORD language)
{
    wchar_t text[512];
    const DWORD size = FormatMessageW(
        FORMAT_MESSAGE_FROM_SYSTEM | FORMAT_MESSAGE_IGNORE_INSERTS | FORMAT_MESSAGE_MAX_WIDTH_MASK, nullptr,
        code, language, text, static_cast<DWORD>(std::size(text)), nullptr);
    return NarrowText({text, size});
}

} // namespace

int LastSystemError()
{
    return static_cast<int>(GetLastError());
}

void ClearLastSystemError()
{
    SetLastError(ERROR_SUCCESS);
}

bool IsNameTaken(int code)
{
    return code == ERROR_FILE_EXISTS || code == ERROR_ALREADY_EXISTS;
}

bool IsNotFound(int code)
{
    return code == ERROR_FILE_NOT_FOUND || code == ERROR_PATH_NOT_FOUND;
}

bool IsOutOfMemory(int code)
{
    return code == ERROR_NOT_ENOUGH_MEMORY || code == ERROR_OUTOFMEMORY;
}

// Sentences of this program end with a point of their own.
std::string SystemErrorWords(int code)
{
    if (code == 0)
        return {};
    std::string text = SystemText(static_cast<DWORD>(code), kEnglish);
    if (text.empty())
        text = SystemText(static_cast<DWORD>(code), kAnyLanguage);
    text.erase(text.find_last_not_of(" .") + 1); // npos + 1 is 0
    return text.empty() ? ": error " + std::to_string(code) : ": " + text;
}

} // namespace gw
