#include "WindowsCalls.h"

#include <iterator>

namespace gw {

namespace {

// The system counts in int.
int Count(size_t size)
{
    return static_cast<int>(size);
}

constexpr size_t kShortPath = 240; // below the limit for files and for folders

bool HasPrefix(std::wstring_view path)
{
    return path.starts_with(L"\\\\?\\") || path.starts_with(L"\\\\.\\");
}

std::wstring FullPath(const std::wstring& path)
{
    const DWORD size = GetFullPathNameW(path.c_str(), 0, nullptr, nullptr);
    std::wstring full(size, L'\0');
    full.resize(GetFullPathNameW(path.c_str(), size, full.data(), nullptr));
    return full;
}

// Backslashes count only before a quote, where each needs another one.
void AppendQuoted(std::string& line, std::string_view argument)
{
    line += '"';
    size_t backslashes = 0;
    for (const char character : argument)
    {
        if (character == '"')
            line.append(backslashes + 1, '\\');
        backslashes = character == '\\' ? backslashes + 1 : 0;
        line += character;
    }
    line.append(backslashes, '\\');
    line += '"';
}

} // namespace

std::wstring WideText(std::string_view text)
{
    const int size = MultiByteToWideChar(CP_UTF8, 0, text.data(), Count(text.size()), nullptr, 0);
    std::wstring wide(static_cast<size_t>(size), L'\0');
    MultiByteToWideChar(CP_UTF8, 0, text.data(), Count(text.size()), wide.data(), size);
    return wide;
}

std::string NarrowText(std::wstring_view text)
{
    const int size =
        WideCharToMultiByte(CP_UTF8, 0, text.data(), Count(text.size()), nullptr, 0, nullptr, nullptr);
    std::string narrow(static_cast<size_t>(size), '\0');
    WideCharToMultiByte(CP_UTF8, 0, text.data(), Count(text.size()), narrow.data(), size, nullptr, nullptr);
    return narrow;
}

std::wstring WidePath(std::string_view path)
{
    std::wstring wide = WideText(path);
    if (wide.size() < kShortPath || HasPrefix(wide))
        return wide;
    const std::wstring full = FullPath(wide);
    if (full.empty() || HasPrefix(full))
        return wide;
    // A share's "\\server\share" becomes "\\?\UNC\server\share".
    return full.starts_with(L"\\\\") ? L"\\\\?\\UNC" + full.substr(1) : L"\\\\?\\" + full;
}

bool WidePath(const char* path, wchar_t (&wide)[4096])
{
    return MultiByteToWideChar(CP_UTF8, 0, path, -1, wide, Count(std::size(wide))) > 0;
}

std::wstring CommandLine(std::span<const std::string> arguments)
{
    std::string line;
    for (const std::string& argument : arguments)
    {
        if (!line.empty())
            line += ' ';
        AppendQuoted(line, argument);
    }
    return WideText(line);
}

void CHandle::Close()
{
    if (!m_pkHandle)
        return;
    const DWORD error = GetLastError();
    CloseHandle(m_pkHandle);
    m_pkHandle = nullptr;
    SetLastError(error);
}

} // namespace gw
